#pragma once

#include "LogGenerator/Osprey/Base.h"
#include "LogGenerator/Osprey/CodeDictionary.h"

#include <memory>
#include <string>
#include <vector>

namespace pelorus {

/// Owns the display sections of one technology and routes log codes to them. A technology's index is a
/// subclass whose members are its sections, in creation order; that order is the order in which the
/// subscribers of one code receive a packet.
class ClassIndex {
public:
    ClassIndex() = default;
    ClassIndex(const ClassIndex&) = delete;
    ClassIndex& operator=(const ClassIndex&) = delete;
    virtual ~ClassIndex();

    /// nullptr when no section has that name.
    Base* getClass(const std::string& sectionName) const;
    /// nullptr when nobody subscribes.
    const CodeDictionary::Subscribers* getSubscribers(LogCode code) const
    {
        return codeDictionary.find(code);
    }
    /// Brings the display entries of all sections up to date.
    void settle();
    /// Decimal texts, each code once.
    std::vector<std::string> getAllLogCodes() const { return codeDictionary.allKeys(); }
    /// A diagnostic for the system log.
    void status() const;

protected:
    /// Makes a section and registers it.
    template <class Section> std::unique_ptr<Section> create()
    {
        auto section = std::make_unique<Section>();
        section->initWithDict(classDict, codeDictionary);
        sections.push_back(section.get());
        return section;
    }

private:
    ClassDictionary classDict;
    std::vector<Base*> sections; // in creation order; of two with one name the dictionary has the later
    CodeDictionary codeDictionary;
};

} // namespace pelorus
