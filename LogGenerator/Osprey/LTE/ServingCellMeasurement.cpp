#include "LogGenerator/Osprey/LTE/ServingCellMeasurement.h"

#include "LogGenerator/Osprey/LTE/LogCode_0xB17F.h"

namespace pelorus {

namespace {

constexpr ValueText kNoPower[] = {{64, "Not Present"}};
constexpr ValueText kNoSearch[] = {{32, "Not Present"}};
constexpr std::string_view kTruth[] = {"False", "True"};

using Layout = LogCode_0xB17F;
constexpr Row kRows[] = {
    number("Version", "%d", Layout::version),
    number("E-ARFCN", "%d", Layout::earfcn),
    number("Physical Cell ID", "%d", Layout::physicalCellIdentity),
    number("Serving Layer Priority", "%d", Layout::servingLayerPriority),
    level("Measured RSRP", "%4.2f dBm", Layout::measuredRsrp, 0.25, -140.0),
    level("Average RSRP", "%4.2f dBm", Layout::averageRsrp, 0.25, -140.0),
    level("Measured RSRQ", "%4.2f dB", Layout::measuredRsrq, 0.25, -30.0),
    level("Average RSRQ", "%4.2f dB", Layout::averageRsrq, 0.25, -30.0),
    level("Measured RSSI", "%4.2f dBm", Layout::measuredRssi, 0.5, -140.0),
    number("Qrxlevmin", "%d dBm", Layout::qrxlevmin, {2, -140}),
    number("P_Max", "%d dBm", Layout::maximumPower, {1, -30}).with(kNoPower),
    // 6 bits wide: never 64, so never "Not Present"; meant
    number("Max UE Tx Power", "%d dBm", Layout::maximumTransmitPower, {1, -30}).with(kNoPower),
    number("Srxlev", "%d dBm", Layout::srxlev, {1, -30}), // a difference, shown in dBm: meant
    number("Num of Consecutive DRX Cycles of S < 0", "%d", Layout::weakDrxCycles),
    number("S Intra Search", "%d dB", Layout::sIntraSearch, {2, 0}).with(kNoSearch),
    number("S Non Intra Search", "%d dBm", Layout::sNonIntraSearch, {2, 0}).with(kNoSearch), // in dBm: meant
    text("Measurement Rules Updated", Layout::measurementRulesUpdated, kTruth, {}),
    number("Measurement Rules", "%d", Layout::measurementRules),
};
constexpr Reading kReadings[] = {{0xB17F, Layout::minimumLength, kRows}};
constexpr SectionDescription kDescription{"Serving Cell Measurements", "Serving Cell Measurements",
                                          kReadings};

} // namespace

ServingCellMeasurement::ServingCellMeasurement() : TableSection(kDescription) {}

} // namespace pelorus
