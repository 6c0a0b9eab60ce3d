#include "tests/simulation/GsmWitness.h"

#include <cmath>
#include <fmt/format.h>

namespace pelorus::test {

void GsmWitness::expect(bool holds, const std::string& fault)
{
    if (!holds && faults.size() < 20)
        faults.push_back(fmt::format("at {:.2f} s: {}", now, fault));
}

void GsmWitness::expectGrowing(std::map<int, std::int64_t>& counters, int key, std::int64_t value)
{
    const auto [counter, isNew] = counters.emplace(key, value);
    expect(isNew || value >= counter->second, fmt::format("counter {} fell to {}", key, value));
    counter->second = value;
}

void GsmWitness::see(const SeenMessage& message)
{
    now = message.seconds();
    switch (message.code()) {
    case 0x7132:
        return registration.enter(message.u8(13));
    case 0x7131:
        expect(message.u8(14) <= 8 && message.u8(15) <= 1, "MM");
        return mm.enter(message.u8(13));
    case 0x7130:
        expect(message.u8(14) <= 12 && message.u8(15) <= 1, "GMM");
        return gmm.enter(message.u8(13));
    case 0x512C:
        rrState = message.u8(13);
        if (rrState == 5)
            activeSet.clear(); // in GSM
        return rr.enter(rrState);
    case 0x4125:
        if (message.u8(13) == 3 && rrcState != 3) {
            harqCounters.clear();
            blockCounters.clear();
        }
        rrcState = message.u8(13);
        return rrc.enter(rrcState);
    case 0x417A:
        return seeCellSet(message);
    case 0x4005:
        return seeRankedCells(message);
    case 0x4031:
        return seeTransmitPower(message);
    case 0x4221:
        return seeHarq(message);
    case 0x4116:
        return seeBlockErrors(message);
    case 0x5137:
        return seeGsmMeasurement(message);
    case 0x5134:
        if (!servingArfcns.empty() && rrState != 14 && rrState != 13 && rrState != 21)
            unannounced += gsmNeighbours.contains(message.u16(13)) ? 0 : 1;
        servingArfcns.insert(message.u16(13));
        return;
    case 0x7135:
        return seeServingNetwork(message);
    case 0xFF0001:
        return seeCells(message);
    default:
        return;
    }
}

void GsmWitness::seeCellSet(const SeenMessage& message)
{
    const auto count = static_cast<std::size_t>(message.u8(15));
    expect(message.size() == 16 + (15 + 44) * count, "length of 417A");
    std::set<int> active;
    std::set<int> others;
    for (std::size_t cell = 0; cell < count; ++cell) {
        const std::size_t entry = 16 + 15 * cell;
        const int code = message.u8(entry + 7) | (message.u8(entry + 8) & 0x1F) << 8;
        const bool isActive = message.u8(entry + 8) >> 5 == 0;
        expect((isActive ? active : others).insert(code).second, "a cell twice");
        const auto linear = static_cast<double>(message.u32(16 + 15 * count + 44 * cell + 32));
        const int ecio = static_cast<int>(std::floor(10 * std::log10(linear / 524288)));
        const int rscp = (message.s16(13) + 512) / 10 - 106 + ecio;
        expect(ecio >= (isActive ? -21 : -19) && ecio <= -3, fmt::format("Ec/Io {}", ecio));
        expect(rscp >= -125 && rscp <= -40, fmt::format("RSCP {}", rscp));
        if (isActive) {
            ++ratios[ecio];
            lowestRscp = std::min(lowestRscp, rscp);
            highestRscp = std::max(highestRscp, rscp);
        }
    }
    expect(!active.empty() && active.size() <= 3, "size of the active set");
    expect(rrcState == 3 || active.size() == 1, "more than one cell in idle mode");
    activeSetSizes.insert(active.size());
    if (rrcState == 0)
        servingScramblingCodes.insert(active.begin(), active.end());
    for (const int code : active)
        if (!activeSet.empty() && !activeSet.contains(code) && !monitored.contains(code))
            ++unannounced;
    activeSet = active;
    monitored = others;
}

void GsmWitness::seeRankedCells(const SeenMessage& message)
{
    const int umts = message.u8(13);
    const int gsm = message.u8(14);
    expect(umts == 0 || gsm == 0, "two kinds of ranked cells");
    expect(message.size() == static_cast<std::size_t>(15 + 10 * umts + 7 * gsm), "length of 4005");
    int last = 32767;
    for (int cell = 0; cell < umts; ++cell) {
        const auto entry = static_cast<std::size_t>(15 + 10 * cell);
        expect(message.u16(entry) == 10638 && message.u16(entry + 2) <= 511, "ranked UMTS cell");
        const int rscp = message.s8(entry + 4) - 21;
        expect(rscp >= -125 && rscp <= -40, fmt::format("RSCP {}", rscp));
        expect(message.s8(entry + 7) >= -40 && message.s8(entry + 7) <= -4, "Ec/No");
        expect(message.s16(entry + 8) <= last, "order of the ranks");
        last = message.s16(entry + 8);
    }
    for (int cell = 0; cell < gsm; ++cell) {
        const auto entry = static_cast<std::size_t>(15 + 7 * cell);
        expect(message.u16(entry) <= 124 && message.u16(entry + 2) <= 63, "ranked GSM cell");
        expect(message.s8(entry + 4) >= -110 && message.s8(entry + 4) <= -47, "RSSI");
        expect(message.s16(entry + 5) <= last, "order of the ranks");
        last = message.s16(entry + 5);
    }
}

void GsmWitness::seeTransmitPower(const SeenMessage& message)
{
    expect(rrcState == 3, "transmit power without CELL_DCH");
    const int count = message.u8(14);
    expect(message.size() == static_cast<std::size_t>(16 + 14 * count), "length of 4031");
    for (int sample = 0; sample < count; ++sample) {
        const int raw = message.s16(static_cast<std::size_t>(16 + 14 * sample + 4));
        const int power = (raw + 512) / 10 - 70;
        expect(raw != 0 && power >= -50 && power <= 24, fmt::format("{} dBm", power));
    }
}

void GsmWitness::seeHarq(const SeenMessage& message)
{
    const int primary = message.u8(16);
    const int secondary = message.u8(17);
    const int carriers = message.u8(15) >> 2 & 3;
    expect(primary == 6 && secondary == (carriers == 2 ? 6 : 0), "HARQ processes");
    expect(message.size() == static_cast<std::size_t>(secondary == 0 ? 18 + 9 * 6 : 18 + 162 * 6 + 9 * 6),
           "length of 4221");
    for (int process = 0; process < primary + secondary; ++process) {
        const int start = process < 6 ? 18 + 9 * process : 18 + 162 * 6 + 9 * (process - 6);
        const auto entry = static_cast<std::size_t>(start);
        expect(message.u8(entry) == process % 6, "identity of a process");
        expectGrowing(harqCounters, process, message.u32(entry + 1));
        expectGrowing(harqCounters, 100 + process, message.u16(entry + 5));
        expectGrowing(harqCounters, 200 + process, message.u16(entry + 7));
        expect(message.u16(entry + 7) <= message.u16(entry + 5), "more errors than blocks");
    }
}

void GsmWitness::seeBlockErrors(const SeenMessage& message)
{
    const int count = message.u8(13);
    expect(count > 0 && message.size() == static_cast<std::size_t>(16 + 9 * count), "length of 4116");
    for (int channel = 0; channel < count; ++channel) {
        const auto entry = static_cast<std::size_t>(16 + 9 * channel);
        const std::int64_t received = message.u32(entry + 1);
        const std::int64_t inError = message.u32(entry + 5);
        expectGrowing(blockCounters, message.u8(entry), received);
        expectGrowing(blockCounters, 1000 + message.u8(entry), inError);
        expect(inError * 4 <= received + 40, fmt::format("{} of {} blocks in error", inError, received));
    }
}

void GsmWitness::seeGsmMeasurement(const SeenMessage& message)
{
    const int count = message.u8(28);
    expect(count <= 6 && message.size() == static_cast<std::size_t>(29 + 14 * count), "length of 5137");
    expect(message.u8(15) <= 63, "RXLEV");
    expect(message.u32(16) <= 70 && message.u32(20) <= 70, "C1 and C2, or RXQUAL");
    gsmNeighbours.clear();
    for (int neighbour = 0; neighbour < count; ++neighbour) {
        const auto entry = static_cast<std::size_t>(29 + 14 * neighbour);
        gsmNeighbours.insert(message.u16(entry));
        expect(message.u8(entry + 2) <= 63, "RXLEV of a neighbour");
        expect(static_cast<std::int32_t>(message.u32(entry + 3)) == message.u8(entry + 2) - 6,
               "C1 of a neighbour");
    }
}

void GsmWitness::seeServingNetwork(const SeenMessage& message)
{
    expect(message.u8(15) == 0x00 && message.u8(16) == 0xF1 && message.u8(17) == 0x10, "001/01");
    if (message.u8(14) != 3) {
        expect(routingAreas.empty() && message.u8(20) == 0, "restricted service though registered");
        serviceTypes.push_back(message.u8(14));
        return;
    }
    locationAreas.insert(message.u8(18) << 8 | message.u8(19));
    routingAreas.insert(message.u8(20));
}

} // namespace pelorus::test
