#include "LogGenerator/Osprey/LTE/NeighborMeasurementMisc.h"

#include "LogGenerator/Osprey/LTE/LogCode_0xB180.h"

namespace pelorus {

namespace {

using Layout = LogCode_0xB180;
constexpr Row kRows[] = {
    number("Version", "%d", Layout::version),
    number("E-ARFCN", "%d", Layout::earfcn),
    number("Qrxlevmin", "%d dBm", Layout::qrxlevmin, {2, -140}),
};
constexpr Reading kReadings[] = {{0xB180, Layout::minimumLength, kRows}};
constexpr SectionDescription kDescription{"Neighbor Measurements", "Neighbor Measurements", kReadings};

} // namespace

NeighborMeasurementMisc::NeighborMeasurementMisc() : TableSection(kDescription) {}

} // namespace pelorus
