#include "LogGenerator/Osprey/LTE/ReselectionCandidatesList.h"

#include "LogGenerator/Osprey/LTE/LogCode_0xB186.h"

namespace pelorus {

namespace {

using Layout = LogCode_0xB186;
using Candidate = Layout::Candidate;

constexpr Row kPriorityRow[] = {number("Candidate Priority", "%d", Candidate::priority)};
constexpr Row kLTERows[] = {
    number("E ARFCN", "%d", Candidate::earfcn),
    number("Cell ID", "%d", Candidate::cellIdentity),
};
constexpr Row kUTRANRows[] = {
    number("U ARFCN", "%d", Candidate::uarfcn),
    number("PSC", "%d", Candidate::scramblingCode),
};
constexpr Row kGERANRows[] = {
    number("ARFCN", "%d", Candidate::arfcn),
    number("Band", "%d", Candidate::band),
    number("BSIC ID", "%d", Candidate::stationIdentity),
};
constexpr Row kCDMARows[] = {
    number("Band", "%d", Candidate::bandClass),
    number("Channel", "%d", Candidate::channel),
    number("Pilot", "%d", Candidate::pilot),
};

struct Technology {
    std::string_view name;
    std::span<const Row> rows;
};
constexpr Technology kTechnologies[] = {{"LTE", kLTERows},
                                        {"UTRAN", kUTRANRows},
                                        {"GERAN", kGERANRows},
                                        {"CDMA1XRTT", kCDMARows},
                                        {"CDMAHRPD", kCDMARows}};
constexpr Technology kUnknownTechnology{"??", {}};

void showCandidates(TableSection& section, const LogPacket& data)
{
    const auto count = static_cast<std::size_t>(data[Layout::candidateCount]);
    // Only the low 8 bits count, so 256 candidates are none: meant.
    const std::size_t shown = data.wholeRecords(Layout::candidates, count & 0xFF);
    section.buildList(shown, [&](std::size_t index, RowWriter& rows) {
        const auto bytes = data.recordAndBeyond<Candidate::reach>(Layout::candidates, index, count);
        const PacketView candidate(bytes);
        const auto technology = static_cast<std::size_t>(candidate[Candidate::technology]);
        const Technology& kind =
            technology < std::size(kTechnologies) ? kTechnologies[technology] : kUnknownTechnology;
        rows.show(kPriorityRow, candidate);
        rows.next("Candidate RAT Type").text().assign(kind.name);
        rows.show(kind.rows, candidate);
        return true;
    });
}

constexpr Reading kReadings[] = {{0xB186, Layout::minimumLength, {}, showCandidates, overtakesAlways}};
constexpr SectionDescription kDescription{"Reselection Candidates List", "Reselection Candidates List",
                                          kReadings};

} // namespace

ReselectionCandidatesList::ReselectionCandidatesList() : TableSection(kDescription) {}

} // namespace pelorus
