#include "LogGenerator/Osprey/LTE/ReselectionCandidatesMisc.h"

#include "LogGenerator/Osprey/LTE/LogCode_0xB186.h"

namespace pelorus {

namespace {

using Layout = LogCode_0xB186;
constexpr Row kRows[] = {
    number("Version", "%d", Layout::version),
    number("Serving EARFCN", "%d", Layout::servingEarfcn),
    number("Serving Cell ID", "%d", Layout::servingCellIdentity),
};
constexpr Reading kReadings[] = {{0xB186, Layout::minimumLength, kRows}};
constexpr SectionDescription kDescription{"Reselection Candidates", "Reselection Candidates", kReadings};

} // namespace

ReselectionCandidatesMisc::ReselectionCandidatesMisc() : TableSection(kDescription) {}

} // namespace pelorus
