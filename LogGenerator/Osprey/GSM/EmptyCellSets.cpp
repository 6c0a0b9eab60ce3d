#include "LogGenerator/Osprey/GSM/EmptyCellSets.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x417A.h"

namespace pelorus {

namespace {

void showNoCell(TableSection& section, const LogPacket&)
{
    section.clearList();
}

constexpr Reading kReadings[] = {{0x417A, LogCode_0x417A::minimumLength, {}, showNoCell, overtakesAlways}};
constexpr SectionDescription kDetectedSet{"Detected Set", "DetectedSet", kReadings};
constexpr SectionDescription kMonitoredSet{"Monitored Set", "MonitoredSet", kReadings};
constexpr SectionDescription kVirtualActiveSet{"Virtual Active Set", "VirtualActiveSet", kReadings};

} // namespace

DetectedSet::DetectedSet() : TableSection(kDetectedSet) {}
MonitoredSet::MonitoredSet() : TableSection(kMonitoredSet) {}
VirtualActiveSet::VirtualActiveSet() : TableSection(kVirtualActiveSet) {}

} // namespace pelorus
