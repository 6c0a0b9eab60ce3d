#pragma once

#include "LogGenerator/Osprey/Base.h"
#include "LogGenerator/Osprey/ListRewriter.h"
#include "LogGenerator/Osprey/Row.h"
#include "platform/SystemLog.h"

#include <span>
#include <string_view>
#include <vector>

namespace pelorus {

class TableSection;

/// Whether the later of two packets shows all the rows that the earlier one shows, so that nobody who looks
/// at the display behind both sees anything of the earlier one.
using Overtakes = bool(const LogPacket& earlier, const LogPacket& later);
Overtakes overtakesAlways;

/// What a section does with the packets of one log code: nothing when they are shorter than `minimumLength`
/// bytes; else it shows `rows` in its keyed entry and then calls `show`, where each is given.
struct Reading {
    LogCode code;
    std::size_t minimumLength;
    std::span<const Row> rows = {};
    void (*show)(TableSection& section, const LogPacket& data) = nullptr;
    /// For a `show` that keeps nothing of its own and raises nothing: packets need not be shown that others
    /// overtake between two looks at the display. Rows alone need no leave.
    Overtakes* overtakes = nullptr;
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
    explicit TableSection(const SectionDescription& what);

    std::string getSectionName() const override { return std::string(description.name); }
    std::vector<LogCode> getLogCodeArray() const override;
    void updateWithData(const LogPacket& data, LogCode logCode) override;
    void receive(const LogPacket& data, LogCode logCode) override;
    void settle() override;
    void updateSectionRef(const Value& entry) override;

    // For the readings' functions.

    Dictionary* entry() { return keyedEntry(); }
    /// The list that a row of the keyed entry holds; it is made where the row has none.
    Array* listRow(Label label);

    void clearList() { rewriter.clear(*listEntry()); }
    /// Shows one dictionary of rows for each of the `count` records that lies wholly inside the packet.
    void showList(PacketView data, Records records, std::size_t count, std::span<const Row> rows)
    {
        showList(*listEntry(), data, records, count, rows);
    }
    void showList(Array& list, PacketView data, Records records, std::size_t count,
                  std::span<const Row> rows);
    /// Shows `count` dictionaries; `fill(index, rows)` writes the rows of each and says whether it is kept.
    template <class Fill> void buildList(std::size_t count, Fill fill)
    {
        rewriter.rewriteRows(*listEntry(), count, fill);
    }
    /// Makes `list` one of `count` texts; `fill(index, text)` writes each.
    template <class Fill> void buildTexts(Array& list, std::size_t count, Fill fill)
    {
        rewriter.rewriteTexts(list, count, fill);
    }

    static void logUnknownCode(LogCode code);

private:
    struct Source {
        const Reading& reading;
        Overtakes* overtakes; // null when every packet must be shown
        bool shown = false;   // a packet since the section was bound, so that its rows are there
        std::vector<std::byte> waiting = {};
    };

    /// The source of a packet that is to be shown; null when it is none of the section's, or too short.
    Source* accept(const LogPacket& data, LogCode logCode);
    void show(Source& source, const LogPacket& data);

    const SectionDescription& description;
    ListRewriter rewriter;
    std::vector<Source> sources;
    std::vector<Source*> waitingSources; // in the order in which their packets came
};

} // namespace pelorus
