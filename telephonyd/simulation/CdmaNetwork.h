#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

namespace pelorus {

/// A sector of a CDMA2000 network, which carries 1x on one channel and EV-DO on another.
struct CdmaSector {
    std::uint8_t site; // index of kSites
    double eastward;   // where its antenna looks, a unit vector
    double northward;
    std::uint16_t pilot; // PN offset in units of 64 chips
    std::uint16_t baseStation;
    std::uint16_t systemIdentifier;
    std::uint16_t networkIdentifier;
    std::uint8_t packetZone;
    std::uint8_t roamingIndicator;
    std::uint8_t colorCode; // of the EV-DO subnet
};

constexpr std::uint8_t kCdmaBandClass = 0; // 1x: 800 MHz
constexpr std::uint16_t kCdmaChannel = 384;
constexpr std::uint8_t kEvdoBandClass = 1; // EV-DO: 1.9 GHz
constexpr std::uint16_t kEvdoChannel = 425;
constexpr std::uint8_t kCdmaProtocolRevision = 6; // IS-2000
constexpr std::size_t kCdmaSectorCount = 9;
extern const std::array<CdmaSector, kCdmaSectorCount> kCdmaSectors;

} // namespace pelorus
