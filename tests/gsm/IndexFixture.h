#pragma once

#include "LogGenerator/Osprey/GSM/OSP_GSMClassIndex.h"
#include "tests/support/SectionFixture.h"

#include <set>
#include <string>

namespace pelorus::test {

inline bool showsAList(const std::string& section)
{
    static const std::set<std::string> kLists{
        "Active Set",       "Detected Set",      "Equivalent PLMN List", "GSM Set",
        "Monitored Set",    "Neighboring Cells", "Non-Ranked GSM Set",   "Non-Ranked UMTS Set",
        "PDP Context Info", "UMTS Set",          "Virtual Active Set"};
    return kLists.contains(section);
}

/// A section of the index by its name, bound to an entry that shows one old row.
class NamedSection {
public:
    explicit NamedSection(const std::string& name)
        : section(index.getClass(name)), entry(showsAList(name) ? Value(makeArray({oldRow()})) : oldRow())
    {
        section->updateSectionRef(entry);
        log.take();
    }

    void receive(LogCode code, const PacketBuilder& packet)
    {
        section->updateWithData(LogPacket(packet.bytes()), code);
    }
    /// Everything that the section shows, in one text.
    std::string shown() const { return textOf(entry); }
    static std::string shownBefore(const std::string& name)
    {
        return showsAList(name) ? "-\n  Old: row\n" : "Old: row\n";
    }

    RecordingLog log;
    OSP_GSMClassIndex index;
    Base* section;
    Value entry;

private:
    static Value oldRow() { return makeDictionary({{"Old", "row"}}); }
};

} // namespace pelorus::test
