#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

namespace pelorus {

struct UmtsCell {
    std::uint8_t site; // index of kSites
    double eastward;   // where its antenna looks, a unit vector
    double northward;
    std::uint16_t scramblingCode;
    std::uint32_t cellIdentity; // 28 bits: radio network controller, then its cell
    std::uint16_t locationArea;
    std::uint8_t routingArea;
    std::uint16_t registrationArea; // URA
};

constexpr std::uint16_t kUmtsUarfcn = 10638; // of all cells, band I
constexpr std::uint16_t kUmtsUplinkUarfcn = 9688;
constexpr std::uint8_t kUmtsBand = 1;
constexpr std::size_t kUmtsCellCount = 6;
extern const std::array<UmtsCell, kUmtsCellCount> kUmtsCells;

} // namespace pelorus
