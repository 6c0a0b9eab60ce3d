#include "LogGenerator/Osprey/LTE/ConnectedModeMeasurementMisc.h"

#include "LogGenerator/Osprey/LTE/LogCode_0xB179.h"

namespace pelorus {

namespace {

using Layout = LogCode_0xB179;
constexpr Row kRows[] = {
    number("E-ARFCN", "%d", Layout::earfcn),
    number("Serving Physical Cell ID", "%d", Layout::servingCellIdentity),
    number("Subframe Number", "%d", Layout::subframeNumber),
    level("Serving Filtered RSRP", "%4.2f dBm", Layout::servingRsrp, 0.25, -140.0),
    level("Serving Filtered RSRQ", "%4.2f dB", Layout::servingRsrq, 0.125, -20.0),
};
constexpr Reading kReadings[] = {{0xB179, Layout::minimumLength, kRows}};
constexpr SectionDescription kDescription{"Connected mode LTE Intra-frequency Measurement",
                                          "Connected mode LTE Intra-frequency Measurement", kReadings};

} // namespace

ConnectedModeMeasurementMisc::ConnectedModeMeasurementMisc() : TableSection(kDescription) {}

} // namespace pelorus
