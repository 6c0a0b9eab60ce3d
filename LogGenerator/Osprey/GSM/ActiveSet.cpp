#include "LogGenerator/Osprey/GSM/ActiveSet.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x417A.h"

namespace pelorus {

namespace {

using Layout = LogCode_0x417A;
constexpr std::int64_t kActiveSet = 0;
constexpr Format kDecibels = "%d dB";
constexpr Row kCellRows[] = {number("Scrambling Code", "%d", Layout::Cell::scramblingCode)};

std::int64_t energyPerChip(PacketView measurement)
{
    std::int64_t linear = 0;
    for (const Field reported : Layout::Measurement::ecio)
        if (linear == 0)
            linear = measurement[reported];
    return Base::lookUpECNO(static_cast<std::uint32_t>(linear));
}

void showCells(TableSection& section, const LogPacket& data)
{
    const auto reported = static_cast<std::size_t>(data[Layout::cellCount]);
    const Records measurements = Layout::measurements(reported);
    const std::size_t count = data.wholeRecords(measurements, reported); // their cells stand before them
    const std::int64_t power = (data[Layout::receivedPower] + 512) / 10 - 106;
    section.buildList(count, [&](std::size_t index, RowWriter& rows) {
        const PacketView cell = data.record(Layout::cells, index, count);
        if (cell[Layout::Cell::set] != kActiveSet)
            return false;
        const std::int64_t energy = energyPerChip(data.record(measurements, index, count));
        rows.show(kCellRows, cell);
        writeNumber(kDecibels, power + energy, rows.next("RSCP"));
        writeNumber(kDecibels, energy, rows.next("Energy Per Chip"));
        return true;
    });
}

constexpr Reading kReadings[] = {{0x417A, Layout::minimumLength, {}, showCells, overtakesAlways}};
constexpr SectionDescription kDescription{"Active Set", "ActiveSet", kReadings};

} // namespace

ActiveSet::ActiveSet() : TableSection(kDescription) {}

} // namespace pelorus
