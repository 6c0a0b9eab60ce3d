#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>

namespace pelorus {

struct GsmCell {
    std::uint8_t site; // index of kSites
    double eastward;   // where its antenna looks, a unit vector
    double northward;
    std::uint16_t arfcn;     // of the broadcast channel
    std::uint8_t colourCode; // BSIC
    std::uint16_t cellIdentity;
    std::uint16_t locationArea;
    std::uint8_t routingArea;
    std::uint8_t reselectOffset;  // dB, of C2
    std::uint8_t hoppingSequence; // HSN
    std::array<std::uint16_t, 4> hoppingChannels;
    // What it says of GPRS, coded as the log has it.
    std::uint8_t networkControlOrder;
    std::uint8_t t3192;
    std::uint8_t drxTimer; // seconds
    bool longAccessBursts;
};

constexpr std::uint8_t kGsmBand = 0;
constexpr std::size_t kGsmCellCount = 9;
extern const std::array<GsmCell, kGsmCellCount> kGsmCells;

} // namespace pelorus
