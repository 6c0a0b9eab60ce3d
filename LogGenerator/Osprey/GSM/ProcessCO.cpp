#include "LogGenerator/Osprey/GSM/ProcessCO.h"

#include "LogGenerator/Osprey/GSM/MobilityRows.h"

namespace pelorus {

namespace {

constexpr Row kRows[] = {kMobilityStateRow};
constexpr Reading kReadings[] = {
    {0x7131, LogCode_0x7131::minimumLength, kRows},
    kRegistrationReading,
};
// Announces itself as ProcessCS: meant.
constexpr SectionDescription kDescription{"Process CO", "ProcessCS", kReadings};

} // namespace

ProcessCO::ProcessCO() : TableSection(kDescription) {}

} // namespace pelorus
