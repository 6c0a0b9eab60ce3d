#pragma once

#include "LogGenerator/Osprey/CodeDictionary.h"
#include "LogGenerator/Osprey/LogPacket.h"
#include "platform/Value.h"

#include <memory>
#include <string>
#include <vector>

namespace pelorus {

/// One display section: it subscribes to log codes and turns each packet of theirs into rows of its display
/// entry.
///
/// The entry belongs to the display dictionary; a section that is not bound to one decodes all the same, and
/// what it writes goes nowhere.
class Base {
public:
    virtual ~Base() = default;

    /// Registers the section under its name, and as a subscriber of each of its codes.
    void initWithDict(ClassDictionary& classDict, CodeDictionary& codeDict);

    // What every section implements. On Base itself each throws std::logic_error: a programming error.
    virtual std::string getSectionName() const;
    virtual std::vector<LogCode> getLogCodeArray() const;
    virtual void updateWithData(const LogPacket& data, LogCode logCode);

    /// As updateWithData(), but what the packet shows may wait until settle(), when it is known which packets
    /// were overtaken by others.
    virtual void receive(const LogPacket& data, LogCode logCode) { updateWithData(data, logCode); }
    /// Brings the display entry up to date. Whoever looks at it settles first.
    virtual void settle() {}

    /// Binds the section to its display entry, a dictionary or an array.
    virtual void updateSectionRef(const Value& entry);
    void updateLogCodeDict(CodeDictionary& codeDict);

    static void clearElementsInArray(Array& array);
    /// As above; `removed` gets what the array held.
    static void clearElementsInArray(Array& array, std::vector<Value>& removed);
    /// `elements` is left empty.
    static void replaceArray(Array& array, std::vector<Value>& elements);

    /// Whole decibels of a linear energy ratio with full scale at 2^19. Values at or above full scale and
    /// values up to 705 both give 0, and 706 to 756 give -31 as the band above them: meant.
    static std::int16_t lookUpECNO(std::uint32_t value);

protected:
    Base() = default;

    /// The display entry as the kind that this section fills. One that is unbound, or bound to an entry of
    /// the other kind, gets an empty one that nobody sees. Valid until the display changes.
    Dictionary* keyedEntry() { return sectionRef.keyed.entry(); }
    Array* listEntry() { return sectionRef.list.entry(); }

private:
    Base(const Base&) = delete;
    Base& operator=(const Base&) = delete;

    /// A reference to a container of the display, which the display may drop. Asking whether it did is cheap,
    /// where sharing its ownership for every packet is not.
    template <class Container> class Reference {
    public:
        void bind(const std::shared_ptr<Container>& entry)
        {
            watched = entry;
            bound = entry.get();
        }
        Container* entry()
        {
            if (!watched.expired()) [[likely]]
                return bound;
            unseen = {};
            return &unseen;
        }

    private:
        std::weak_ptr<Container> watched;
        Container* bound = nullptr;
        Container unseen;
    };

    struct {
        Reference<Dictionary> keyed;
        Reference<Array> list;
    } sectionRef;
};

} // namespace pelorus
