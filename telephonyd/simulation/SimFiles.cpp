#include "telephonyd/simulation/SimFiles.h"

#include <fmt/format.h>

namespace pelorus {

namespace {

constexpr const char* kHomeNetwork = "00F110"; // 001/01, nibbles swapped (3GPP TS 24.008, 10.5.1.3)

} // namespace

Value simFiles(std::uint16_t locationAreaCode, std::uint32_t tmsi)
{
    const std::string area = fmt::format("{} {:04X}", kHomeNetwork, locationAreaCode);
    return makeDictionary({
        {"kSimFile_ICCID", "89490100001234567897"},
        {"kSimFile_MSISDN", "+491713920012"},
        {"kSimFile_MBDN", "+491713920099"},
        {"kSimFile_HPPLMN", "05"}, // searched for every 30 minutes
        // TMSI, location area, its timer, updated
        {"kSimFile_LOCI", fmt::format("{:08X} {} FF 00", tmsi, area)},
        // P-TMSI, its signature, routing area, updated
        {"kSimFile_PSLOCI", fmt::format("{:08X} 5B0C17 {} 01 00", tmsi | 0xC0000000U, area)},
        {"kSimFile_ACC", "0080"},
        {"kSimFile_AD", "00000002"}, // normal operation, MNC of two digits
        {"kSimFile_FPLMN", "00F120 00F130 FFFFFF FFFFFF"},
        {"kSimFile_AHPLMN", kHomeNetwork},
        {"kSimFile_RATMODE", "LTE, UMTS, GSM"},
        {"kSimFile_PNN", "Test Network"},
        {"kSimFile_OPL", fmt::format("{} 0000 FFFE 01", kHomeNetwork)},
        {"kSimFile_OPLMNAcT", fmt::format("{0} 4000 {0} 8000 {0} 0080", kHomeNetwork)}, // LTE, UMTS, GSM
    });
}

} // namespace pelorus
