#pragma once

#include "LogGenerator/Osprey/LogPacket.h"
#include "tests/support/PacketBuilder.h"

#include <initializer_list>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>

namespace pelorus::test {

// One packet of each log code with every field set, and with values that differ from field to field. Bytes
// that nobody reads are 0xEE where they stand between fields.

/// Two ranked UMTS cells. No GSM cells: those would be the same bytes once more.
inline PacketBuilder rankedUMTSCells()
{
    return PacketBuilder(35)
        .u8(13, 2)
        .u16(15, 10713)
        .u16(17, 301)
        .s8(19, -80)
        .s16(20, -95)
        .s8(22, -13)
        .s16(23, -1201)
        .u16(25, 0xFFFF)
        .u16(27, 511)
        .s8(29, 10)
        .s16(30, 300)
        .s8(32, 7)
        .s16(33, 12);
}

inline PacketBuilder rankedGSMCells()
{
    return PacketBuilder(29)
        .u8(14, 2)
        .u16(15, 871)
        .u16(17, 43)
        .s8(19, -77)
        .s16(20, -15)
        .u16(22, 0xFFFF)
        .u16(24, 0xFFFE)
        .s8(26, 5)
        .s16(27, 900);
}

/// Three samples of the transmit power: none, 300 and -100.
inline PacketBuilder transmitPower()
{
    return PacketBuilder(58).u8(14, 3).s16(20, 0).s16(34, 300).s16(48, -100);
}

inline PacketBuilder blockErrors()
{
    return PacketBuilder(34)
        .u8(13, 2)
        .u16(14, 500)
        .u8(16, 1)
        .u32(17, 4000)
        .u32(21, 25)
        .u8(25, 255)
        .u32(26, 0x7FFFFFFF)
        .u32(30, 0x80000000);
}

inline PacketBuilder radioResourceState()
{
    return PacketBuilder(14).u8(13, 3);
}

inline PacketBuilder umtsCell()
{
    return PacketBuilder(29).u32(13, 9763).u32(17, 10713).u32(21, 0x0ABCDEF0).u16(25, 65535).u16(27, 0xEEEE);
}

inline PacketBuilder ciphering()
{
    return PacketBuilder(19).u8(13, 1);
}

/// Three cells, of which the first and the last are in the active set. Cells at 16, 31, 46; measurements at
/// 61, 105, 149.
inline PacketBuilder followedCells()
{
    return PacketBuilder(193)
        .s16(13, -600)
        .u8(15, 3)
        .u8(16 + 7, 0x2D)
        .u8(16 + 8, 0x01)
        .u8(31 + 7, 0x0A)
        .u8(31 + 8, 0x20)
        .u8(46 + 7, 0xFF)
        .u8(46 + 8, 0x1F)
        .u32(61 + 32, 90000)
        .u32(61 + 36, 1)
        .u32(105 + 32, 400000)
        .u32(149 + 36, 2000)
        .u32(149 + 40, 1);
}

/// One primary process at 18, two secondary ones at 180.
inline PacketBuilder harqProcesses()
{
    return PacketBuilder(198)
        .u8(13, 2)
        .u8(14, 0xFE)
        .u8(15, 0xFB)
        .u8(16, 1)
        .u8(17, 2)
        .u8(18, 4)
        .u32(19, 70000)
        .u16(23, 300)
        .u16(25, 12)
        .u8(180, 5)
        .u32(181, 0xFFFFFFFF)
        .u16(185, 65535)
        .u16(187, 40000)
        .u8(189, 255)
        .u32(190, 1)
        .u16(194, 2)
        .u16(196, 3);
}

inline PacketBuilder discontinuousTransmission()
{
    return PacketBuilder(20).u8(19, 1);
}

inline PacketBuilder dedicatedChannel()
{
    return PacketBuilder(17).u16(13, 0x0203);
}

inline PacketBuilder gsmState()
{
    return PacketBuilder(17).u8(13, 5).u8(14, 77).u8(15, 88).u8(16, 1);
}

inline PacketBuilder gsmCell()
{
    return PacketBuilder(26).u16(13, 871).u16(15, 43).u16(17, 43981);
}

/// Two neighbours, at 29 and 43.
inline PacketBuilder gsmMeasurement()
{
    return PacketBuilder(57)
        .u16(13, 0xEEEE)
        .u8(15, 190)
        .u32(16, 0xFFFF0020)
        .u32(20, 0x0001FFFE)
        .u8(26, 1)
        .u8(28, 2)
        .u16(29, 62)
        .u8(31, 55)
        .s32(32, -14)
        .u16(43, 1023)
        .u8(45, 255)
        .s32(46, 100000);
}

inline PacketBuilder systemInformation13()
{
    return PacketBuilder(15).u8(13, 0xEE).u8(14, 1);
}

inline PacketBuilder gprsAccess()
{
    return PacketBuilder(18).u8(13, 1).u8(14, 6).u8(15, 2);
}

inline PacketBuilder gprsTimers()
{
    return PacketBuilder(24).u16(13, 0xEEEE).u8(15, 4).u8(16, 60).u8(17, 1);
}

inline PacketBuilder hoppingChannels()
{
    return PacketBuilder(21).u8(13, 63).u8(14, 3).u16(15, 1).u16(17, 1023).u16(19, 65535);
}

inline PacketBuilder packetBroadcast()
{
    return PacketBuilder(34).u8(13, 9);
}

inline PacketBuilder packetInformation()
{
    return PacketBuilder(35).u8(13, 11).u8(14, 12).u8(15, 13).u8(16, 14).u8(17, 0xEE).u8(33, 1);
}

/// The identities of two channels, of which 62 is a neighbour in gsmMeasurement().
inline PacketBuilder stationIdentities()
{
    return PacketBuilder(23).u8(14, 2).u16(15, 62).u8(17, 33).u8(18, 0xEE).u16(19, 700).u8(21, 34);
}

inline PacketBuilder packetSwitchedState()
{
    return PacketBuilder(16).u8(13, 3).u8(14, 9).u8(15, 1);
}

inline PacketBuilder circuitSwitchedState()
{
    return PacketBuilder(16).u8(13, 19).u8(14, 8).u8(15, 2);
}

inline PacketBuilder registrationState()
{
    return PacketBuilder(16).u8(13, 5).u8(14, 1);
}

inline PacketBuilder registeredArea()
{
    return PacketBuilder(32)
        .u8(13, 1)
        .u8(14, 3)
        .u8(15, 0x13)
        .u8(16, 0xF0)
        .u8(17, 0x62)
        .u8(18, 0x12)
        .u8(19, 0x34)
        .u8(20, 7);
}

/// Two networks: six bytes each, three bytes apart.
inline PacketBuilder equivalentNetworks()
{
    return PacketBuilder(26)
        .u8(16, 2)
        .u8(17, 3)
        .u8(18, 2)
        .u8(19, 1)
        .u8(20, 6)
        .u8(21, 0)
        .u8(22, 0)
        .u8(23, 4)
        .u8(24, 5)
        .u8(25, 7);
}

/// A cell of the cell monitor.
inline Value cell(std::string_view technology, std::string_view type,
                  std::initializer_list<std::pair<std::string_view, Value>> entries)
{
    auto dictionary = makeDictionary(entries);
    dictionary->set("CellMonitorCellRadioAccessTechnology",
                    "CellMonitorRadioAccessTechnology" + std::string(technology));
    dictionary->set("CellMonitorCellType", "CellMonitorCellType" + std::string(type));
    return dictionary;
}

inline Value gsmServingCell()
{
    return cell("GSM", "Serving",
                {{"CellMonitorMCC", 262},
                 {"CellMonitorMNC", 1},
                 {"CellMonitorLAC", 1234},
                 {"CellMonitorCellId", 5678},
                 {"CellMonitorARFCN", 87}});
}

inline Value umtsServingCell()
{
    return cell("UMTS", "Serving",
                {{"CellMonitorMCC", 310},
                 {"CellMonitorMNC", 410},
                 {"CellMonitorLAC", 4321},
                 {"CellMonitorCellId", 8765},
                 {"CellMonitorUARFCN", 10588},
                 {"CellMonitorSCN", 99}});
}

inline Value gsmNeighbor()
{
    return cell("GSM", "Neighbor", {{"CellMonitorARFCN", 88}, {"CellMonitorRSSI", -50}});
}

inline Value umtsNeighbor()
{
    return cell("UMTS", "Neighbor",
                {{"CellMonitorUARFCN", 10713},
                 {"CellMonitorSCN", 301},
                 {"CellMonitorRSCP", -95},
                 {"CellMonitorECN0", -7}});
}

inline PacketBuilder monitoredCells(std::initializer_list<Value> cells)
{
    return internalPacket(makeArray(cells));
}

/// A full packet of any code of the index.
inline PacketBuilder fullPacket(LogCode code)
{
    switch (code) {
    case 0x4005:
        return rankedUMTSCells().u8(14, 2);
    case 0x4031:
        return transmitPower();
    case 0x4116:
        return blockErrors();
    case 0x4125:
        return radioResourceState();
    case 0x4127:
        return umtsCell();
    case 0x4157:
        return ciphering();
    case 0x417A:
        return followedCells();
    case 0x4221:
        return harqProcesses();
    case 0x5072:
        return discontinuousTransmission();
    case 0x5076:
        return dedicatedChannel();
    case 0x512C:
        return gsmState();
    case 0x5134:
        return gsmCell();
    case 0x5137:
        return gsmMeasurement();
    case 0x51F4:
        return systemInformation13();
    case 0x51F5:
        return gprsAccess();
    case 0x51F6:
        return gprsTimers();
    case 0x51F8:
        return hoppingChannels();
    case 0x51FB:
        return packetBroadcast();
    case 0x51FD:
        return packetInformation();
    case 0x51FF:
        return stationIdentities();
    case 0x7130:
        return packetSwitchedState();
    case 0x7131:
        return circuitSwitchedState();
    case 0x7132:
        return registrationState();
    case 0x7135:
        return registeredArea();
    case 0x7150:
        return equivalentNetworks();
    case 0xFF0000:
        return internalPacket(makeDictionary({{"kSimFile_ICCID", "8901"}, {"kSimFile_OPLMNAcT", "0801"}}));
    case 0xFF0001:
        return monitoredCells({gsmServingCell(), umtsServingCell(), gsmNeighbor(), umtsNeighbor()});
    case 0xFF0002:
        return internalPacket(makeArray({makeDictionary({{"APN", "internet"}})}));
    default:
        throw std::invalid_argument("no packet of this code");
    }
}

} // namespace pelorus::test
