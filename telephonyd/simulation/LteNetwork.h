#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

namespace pelorus {

/// A frequency of the network, and what its cells broadcast about it.
struct LteCarrier {
    std::uint16_t earfcn; // downlink; uplink is 18000 above (3GPP TS 36.101, table 5.7.3-1)
    std::uint8_t band;
    std::uint8_t resourceBlocks; // bandwidth, the same both ways
    std::uint8_t priority;       // of reselection, higher is better
    double extraLoss;            // dB, against the lower carrier
};

struct LteCell {
    std::uint8_t carrier; // index of kLteCarriers
    std::uint8_t site;    // index of kSites
    std::uint16_t physicalCellIdentity;
    double eastward; // where its antenna looks, a unit vector
    double northward;
    std::uint32_t cellIdentity; // 28 bits: base station, then its cell
    std::uint16_t trackingAreaCode;
    std::uint8_t antennas;
    std::uint16_t frameOffset;  // the network is not synchronous
    std::uint32_t sampleOffset; // in samples of 1/30.72 us, of a frame's 307200
};

constexpr std::size_t kLteCellCount = 12;
constexpr std::size_t kLteCarrierCount = 2;
constexpr std::uint16_t kUplinkEarfcnOffset = 18000;

extern const std::array<LteCarrier, kLteCarrierCount> kLteCarriers;
extern const std::array<LteCell, kLteCellCount> kLteCells;

} // namespace pelorus
