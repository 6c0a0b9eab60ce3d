#pragma once

#include "LogGenerator/Osprey/Base.h"
#include "tests/support/PacketBuilder.h"
#include "tests/support/RecordingLog.h"

#include <string>

namespace pelorus::test {

/// The text of a display entry: "label: value\n" a row, sorted by nothing but the order of the rows;
/// containers as "label:\n" with their content indented by two blanks, elements of a list as "- " lines.
inline std::string textOf(const Value& value, const std::string& indent = "")
{
    if (value.string())
        return *value.string() + "\n";
    std::string text;
    if (const Dictionary* rows = value.dictionary())
        for (const auto& [key, row] : *rows)
            text += indent + std::string(key.text()) +
                    (row.string() ? ": " + textOf(row) : ":\n" + textOf(row, indent + "  "));
    else if (const Array* list = value.array())
        for (const Value& element : list->elements)
            text +=
                indent + (element.string() ? "- " + textOf(element) : "-\n" + textOf(element, indent + "  "));
    else
        text = "(unknown)\n";
    return text;
}

/// One section bound to a display entry of its own, which starts empty.
template <class Section> class SectionFixture {
public:
    explicit SectionFixture(Value displayEntry) : entry(std::move(displayEntry))
    {
        section.initWithDict(classDict, codeDict);
        section.updateSectionRef(entry);
        log.take();
    }
    SectionFixture(const SectionFixture&) = delete;
    SectionFixture& operator=(const SectionFixture&) = delete;

    void receive(LogCode code, const PacketBuilder& packet)
    {
        section.updateWithData(LogPacket(packet.bytes()), code);
    }
    /// As textOf() the display entry.
    std::string shown() const { return textOf(entry); }
    /// The text of one row of a keyed entry; "(none)" when there is no such row.
    std::string row(std::string_view label) const
    {
        const Value* value = entry.dictionary()->find(label);
        return value ? (value->string() ? *value->string() : textOf(*value)) : "(none)";
    }
    std::size_t rowCount() const
    {
        return entry.dictionary() ? entry.dictionary()->size() : entry.array()->elements.size();
    }
    std::vector<std::string> logged() { return log.take(); }

    RecordingLog log;
    ClassDictionary classDict;
    CodeDictionary codeDict;
    Section section;
    Value entry;
};

} // namespace pelorus::test
