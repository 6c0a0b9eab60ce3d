#include "LogGenerator/Osprey/GSM/PlaceholderSections.h"

namespace pelorus {

namespace {

constexpr SectionDescription placeholder(std::string_view name, std::string_view banner)
{
    return {name, banner, {}, UnknownCode::ignored};
}

constexpr auto kCellChangeCounters = placeholder("Cell Change Counters", "CellChangeCounters");
constexpr auto kCodingScheme = placeholder("Coding Scheme", "CellChangeCounters"); // the same banner: meant
constexpr auto kNonRankedGSMSet = placeholder("Non-Ranked GSM Set", "NonRankedGSMSet");
constexpr auto kNonRankedUMTSSet = placeholder("Non-Ranked UMTS Set", "NonRankedUMTSSet");
constexpr auto kUMTSRRMeasurement = placeholder("UMTS RR Measurement", "UMTSRRMeasurement");

} // namespace

CellChangeCounters::CellChangeCounters() : TableSection(kCellChangeCounters) {}
CodingScheme::CodingScheme() : TableSection(kCodingScheme) {}
NonRankedGSMSet::NonRankedGSMSet() : TableSection(kNonRankedGSMSet) {}
NonRankedUMTSSet::NonRankedUMTSSet() : TableSection(kNonRankedUMTSSet) {}
UMTSRRMeasurement::UMTSRRMeasurement() : TableSection(kUMTSRRMeasurement) {}

} // namespace pelorus
