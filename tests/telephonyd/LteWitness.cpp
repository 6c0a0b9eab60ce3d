#include "tests/telephonyd/LteWitness.h"

#include "platform/PropertyList.h"

#include <cmath>
#include <fmt/format.h>
#include <gtest/gtest.h>

namespace pelorus::test {

void LteWitness::expect(bool holds, const std::string& fault)
{
    if (!holds && faults.size() < 20)
        faults.push_back(fmt::format("message {}: {}", seen, fault));
}

void LteWitness::expectLevels(const std::string& where, double rsrp, double rsrq)
{
    expect(rsrp >= -140 && rsrp <= -44, fmt::format("{}: RSRP {}", where, rsrp));
    expect(rsrq >= -19.5 && rsrq <= -3, fmt::format("{}: RSRQ {}", where, rsrq));
}

void LteWitness::see(PacketReader packet)
{
    ++seen;
    ++counts[packet.code()];
    seeHeader(packet);
    switch (packet.code()) {
    case 0xB0C2:
        return seeServingCell(packet);
    case 0xB0C1:
        expect(packet.size() >= 22, "length of B0C1");
        expect(packet.u16(14) == servingCell && packet.u16(16) == servingEarfcn, "cell of B0C1");
        expect(packet.u8(20) == 2 || packet.u8(20) == 4, "antennas");
        return;
    case 0xB17F:
        return seeIdleMeasurement(packet);
    case 0xB180:
        return seeNeighbours(packet);
    case 0xB179:
        return seeConnectedMeasurement(packet);
    case 0xB186:
        return seeCandidates(packet);
    case 0xFF0000:
        return seeSimFiles(packet);
    case 0xFF0001:
        return seeCells(packet);
    case 0xFF0002:
        return seeContexts(packet);
    default:
        expect(false, fmt::format("code {:X}", packet.code()));
    }
}

void LteWitness::seeHeader(PacketReader packet)
{
    expect(packet.u8(0) == 1 || packet.u8(0) == 0xFF, "log type");
    expect(static_cast<std::size_t>(packet.u16(1)) == packet.size() - 1, "record length");
    expect((packet.u8(0) == 0xFF) == (packet.u16(3) < 3), "log type of the code");
}

void LteWitness::seeServingCell(PacketReader packet)
{
    expect(packet.size() >= 38, "length of B0C2");
    const int cell = packet.u16(14);
    const int earfcn = packet.u16(16);
    if (servingCell >= 0) {
        ++(connected ? handovers : reselections);
        unannounced += neighbours[earfcn].count(cell) == 0 ? 1 : 0;
        expect(cell != servingCell, "change to the same cell");
        expect(!connected || earfcn == servingEarfcn, "handover to another carrier");
    }
    servingCell = cell;
    servingEarfcn = earfcn;
    neighbours.clear();
    servingEarfcns.insert(earfcn);
    trackingAreas.insert(packet.u16(26));
    expect(cell <= 503, "physical cell identity");
    expect(packet.u16(18) == earfcn + 18000, "uplink");
    expect(packet.u8(20) == (earfcn == 1850 ? 100 : 50) && packet.u8(21) == packet.u8(20), "bandwidth");
    expect(packet.u32(22) > 0 && packet.u32(22) < 1 << 28, "cell identity");
    expect(packet.u32(28) == (earfcn == 1850 ? 3 : 7), "band");
}

void LteWitness::seeIdleMeasurement(PacketReader packet)
{
    expect(packet.size() >= 33, "length of B17F");
    connected = false;
    expect(packet.u16(17) == servingEarfcn && packet.bits(19, 0, 9) == servingCell, "cell of B17F");
    const double rsrp = packet.bits(19, 16, 9) * 0.25 - 140;
    const double averageRsrp = packet.bits(19, 25, 9) * 0.25 - 140;
    const double rsrq = packet.bits(19, 34, 7) * 0.25 - 30;
    const double rssi = packet.bits(19, 48, 9) * 0.5 - 140;
    expectLevels("B17F", rsrp, rsrq);
    expectLevels("average of B17F", averageRsrp, packet.bits(19, 41, 7) * 0.25 - 30);
    // RSRQ = N RSRP / RSSI, as far as the steps of the fields go
    const double expected = 10 * std::log10(servingEarfcn == 1850 ? 100 : 50) + rsrp - rssi;
    expect(std::abs(rsrq - std::max(expected, -19.5)) <= 0.6, fmt::format("RSRQ {}, not {}", rsrq, expected));
    expect(packet.bits(19, 57, 6) * 2 - 140 == -124, "Qrxlevmin");
    expect(std::abs(packet.bits(19, 80, 7) - 30 - (averageRsrp + 124)) <= 1, "Srxlev");
    expect(packet.bits(19, 63, 7) == 53 && packet.bits(19, 70, 6) == 53, "23 dBm");
    expect(packet.bits(19, 9, 4) == (servingEarfcn == 1850 ? 5 : 6), "priority");
    lowestRsrp = std::min(lowestRsrp, rsrp);
    highestRsrp = std::max(highestRsrp, rsrp);
}

void LteWitness::seeNeighbours(PacketReader packet)
{
    const int count = packet.bits(19, 6, 5) + 1;
    const int earfcn = packet.u16(17);
    expect(packet.size() == 21U + 20U * static_cast<unsigned>(count), "length of B180");
    expect(count <= 6, "neighbours");
    auto& known = neighbours[earfcn];
    known.clear();
    int last = 511;
    for (int i = 0; i < count; ++i) {
        const PacketReader record = packet.from(21 + 20 * static_cast<std::size_t>(i));
        const int cell = record.bits(0, 0, 9);
        const int rsrp = record.bits(0, 17, 9);
        expect(known.insert(cell).second, "the same neighbour twice");
        expect(cell != servingCell, "the serving cell as its neighbour");
        expect(rsrp <= last, "neighbours not in order");
        last = rsrp;
        expectLevels("B180", rsrp * 0.5 - 140, record.bits(0, 41, 7) * 0.25 - 30);
        expectLevels("average of B180", record.bits(0, 32, 9) * 0.5 - 140, record.bits(0, 48, 7) * 0.25 - 30);
        const double expected =
            10 * std::log10(earfcn == 1850 ? 100 : 50) + rsrp * 0.5 - record.bits(0, 9, 8) * 0.5;
        expect(std::abs(record.bits(0, 41, 7) * 0.25 - 30 - expected) <= 0.75, "RSRQ of a neighbour");
        expect(record.bits(0, 107, 19) < 307200, "sample offset");
        expect(record.bits(0, 96, 11) < 1024, "frame offset");
    }
}

void LteWitness::seeConnectedMeasurement(PacketReader packet)
{
    connected = true;
    const auto measured = static_cast<std::size_t>(packet.u8(27));
    const auto detected = static_cast<std::size_t>(packet.u8(28));
    expect(measured <= 8 && detected <= 3, "cells of B179");
    expect(packet.size() == 29 + 6 * measured + 2 * detected, "length of B179");
    expect(packet.u16(17) == servingEarfcn && packet.u16(19) == servingCell, "cell of B179");
    expect(packet.u16(21) <= 9, "subframe");
    expectLevels("B179", packet.u16(23) * 0.25 - 140, packet.u16(25) * 0.125 - 20);
    auto& known = neighbours[servingEarfcn];
    known.clear();
    for (std::size_t i = 0; i < measured; ++i) {
        expect(known.insert(packet.u16(29 + 6 * i)).second, "the same neighbour twice");
        expectLevels("cell of B179", packet.u16(31 + 6 * i) * 0.25 - 140,
                     packet.u16(33 + 6 * i) * 0.125 - 20);
    }
    expect(known.count(servingCell) == 0, "the serving cell as its neighbour");
    for (std::size_t i = 0; i < detected; ++i)
        expect(known.count(packet.u16(29 + 6 * measured + 2 * i)) == 0, "measured and detected");
}

void LteWitness::seeCandidates(PacketReader packet)
{
    const auto count = static_cast<std::size_t>(packet.u16(19));
    expect(packet.u16(15) == servingEarfcn && packet.u16(17) == servingCell, "cell of B186");
    expect(count >= 1 && count <= 2 && packet.size() == 21 + 4 * (count - 1) + 12, "length of B186");
    for (std::size_t i = 0; i < count; ++i)
        seeCandidate(packet.from(21 + 4 * i));
}

/// As it is shown, whatever lies behind the record.
void LteWitness::seeCandidate(PacketReader record)
{
    candidateTechnologies.insert(record.u16(2));
    expect(record.u16(0) <= 7, "priority of a candidate");
    switch (record.u16(2)) {
    case 0:
        expect(record.u16(4) == (servingEarfcn == 1850 ? 3100 : 1850), "EARFCN of a candidate");
        expect(record.u16(6) >> 7 <= 503, "LTE candidate");
        break;
    case 1:
        expect(record.u16(4) >= 10562 && record.u16(4) <= 10838 && record.u16(6) <= 511, "UTRAN candidate");
        break;
    case 2:
        expect(record.u16(4) <= 1023 && record.u8(6) <= 1 && record.u8(7) <= 63, "GERAN candidate");
        break;
    case 3:
        expect(record.u8(4) == 1 && record.u16(8) <= 1199 && record.u16(10) <= 511, "CDMA candidate");
        break;
    default:
        expect(false, "technology of a candidate");
    }
}

void LteWitness::seeSimFiles(PacketReader packet)
{
    const Value files = parsePropertyList(packet.payload());
    ASSERT_TRUE(files.dictionary());
    for (const char* key :
         {"kSimFile_ICCID", "kSimFile_MSISDN", "kSimFile_MBDN", "kSimFile_HPPLMN", "kSimFile_LOCI",
          "kSimFile_PSLOCI", "kSimFile_ACC", "kSimFile_AD", "kSimFile_FPLMN", "kSimFile_AHPLMN",
          "kSimFile_RATMODE", "kSimFile_PNN", "kSimFile_OPL", "kSimFile_OPLMNAcT"}) {
        const Value file = files.dictionary()->at(key);
        expect(file.string() && !file.string()->empty(), key);
    }
}

void LteWitness::seeCells(PacketReader packet)
{
    const Value list = parsePropertyList(packet.payload());
    ASSERT_TRUE(list.array());
    int servingCells = 0;
    for (const Value& element : list.array()->elements) {
        ASSERT_TRUE(element.dictionary());
        const Dictionary& cell = *element.dictionary();
        const auto number = [&cell](const char* key) { return signed32(cell.find(key)); };
        const std::string technology = *cell.at("CellMonitorCellRadioAccessTechnology").string();
        monitoredTechnologies.insert(technology);
        if (*cell.at("CellMonitorCellType").string() == "CellMonitorCellTypeServing") {
            ++servingCells;
            expect(technology == "CellMonitorRadioAccessTechnologyLTE", "technology of the serving cell");
            expect(number("CellMonitorPID") == servingCell, "cell of the list");
            expect(number("CellMonitorUARFCN") == servingEarfcn, "EARFCN of the list");
            expect(number("CellMonitorTAC") == 4301 || number("CellMonitorTAC") == 4302, "TAC of the list");
            expect(number("CellMonitorCellId") > 0, "cell identity of the list");
            expect(number("CellMonitorMCC") == 1 && number("CellMonitorMNC") == 1, "network of the list");
        } else if (technology == "CellMonitorRadioAccessTechnologyUMTS") {
            expect(number("CellMonitorRSCP") >= -120 && number("CellMonitorRSCP") <= -25, "RSCP");
            expect(number("CellMonitorECN0") >= -24 && number("CellMonitorECN0") <= 0, "Ec/N0");
        } else if (technology == "CellMonitorRadioAccessTechnologyGSM") {
            const auto level = number("CellMonitorRSSI");
            expect(level == 32767 || (level >= -55 && level <= -20), "RSSI in half dBm");
        } else {
            expect(number("CellMonitorPID") != servingCell, "the serving cell as its neighbour");
        }
    }
    expect(servingCells == 1, "one serving cell");
}

void LteWitness::seeContexts(PacketReader packet)
{
    const Value list = parsePropertyList(packet.payload());
    ASSERT_TRUE(list.array());
    contextCounts.insert(list.array()->elements.size());
    for (const Value& context : list.array()->elements) {
        ASSERT_TRUE(context.dictionary());
        for (const auto& [name, value] : *context.dictionary())
            expect(value.string(), "a row that is no text");
        expect(bool(context.dictionary()->find("APN")), "APN");
    }
}

} // namespace pelorus::test
