#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

namespace pelorus {

/// A cell of a time-division (TDD) network.
struct UtranCell {
    std::uint8_t site; // index of kSites
    double eastward;   // where its antenna looks, a unit vector
    double northward;
    std::uint16_t uarfcn;           // the same both ways
    std::uint8_t parameterIdentity; // 0 to 127; its scrambling code
    std::uint32_t cellIdentity;     // 28 bits: radio network controller, then its cell
    std::uint16_t locationArea;
    std::uint8_t registrationArea; // URA
};

constexpr std::uint8_t kUtranBand = 1; // 2010 to 2025 MHz
constexpr std::size_t kUtranCellCount = 9;
extern const std::array<UtranCell, kUtranCellCount> kUtranCells;

} // namespace pelorus
