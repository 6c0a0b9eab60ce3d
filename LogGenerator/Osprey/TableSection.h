#pragma once

#include "LogGenerator/Osprey/Base.h"
#include "LogGenerator/Osprey/Row.h"
#include "platform/SystemLog.h"

#include <span>
#include <string_view>

namespace pelorus {

class TableSection;

/// What a section does with the packets of one log code: nothing when they are shorter than `minimumLength`
/// bytes; else it shows `rows` in its keyed entry and then calls `show`, where each is given.
struct Reading {
    LogCode code;
    std::size_t minimumLength;
    std::span<const Row> rows = {};
    void (*show)(TableSection& section, const LogPacket& data) = nullptr;
};

enum class UnknownCode : std::uint8_t { logged, ignored };

/// All of a section that is not code of its own.
struct SectionDescription {
    std::string_view name;
    std::string_view banner; // the system-log line of every call
    std::span<const Reading> readings = {};
    UnknownCode unknownCode = UnknownCode::logged;
    int bannerPriority = kLogWarning;
};

/// A section as its description says it. The order of the readings is the order of subscription.
class TableSection : public Base {
public:
    explicit TableSection(const SectionDescription& what) : description(what) {}

    std::string getSectionName() const override { return std::string(description.name); }
    std::vector<LogCode> getLogCodeArray() const override;
    void updateWithData(const LogPacket& data, LogCode logCode) override;

    // For the readings' functions.

    std::shared_ptr<Dictionary> entry() const { return keyedEntry(); }
    void clearList();
    /// Shows one dictionary of rows for each of the `count` records that lies wholly inside the packet.
    void showList(PacketView data, Records records, std::size_t count, std::span<const Row> rows);
    /// Shows `count` dictionaries; `fill(index, rows)` writes the rows of each and says whether it is kept.
    template <class Fill> void buildList(std::size_t count, Fill fill);
    /// Replaces the list by what `elements` holds.
    void setList(std::vector<Value> elements);

    static void logUnknownCode(LogCode code);

private:
    std::shared_ptr<Dictionary> freshRows();

    const SectionDescription& description;
    std::vector<Value> spare;       // row dictionaries that the display let go of
    std::vector<Value> newElements; // kept for its memory
};

template <class Fill> void TableSection::buildList(std::size_t count, Fill fill)
{
    clearList();
    newElements.clear();
    for (std::size_t index = 0; index < count; ++index) {
        std::shared_ptr<Dictionary> dictionary = freshRows();
        RowWriter rows(*dictionary);
        if (fill(index, rows))
            newElements.emplace_back(std::move(dictionary));
    }
    if (count > 0)
        replaceArray(*listEntry(), newElements);
}

} // namespace pelorus
