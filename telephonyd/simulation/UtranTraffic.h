#pragma once

#include "telephonyd/simulation/UtranRadio.h"

#include <span>

namespace pelorus {

/// What goes over the channels of a TDD connection.
class UtranTraffic {
public:
    static constexpr std::size_t kPositions = 6; // of timeslots

    struct TransportChannel {
        std::uint8_t identity;
        double errorRate; // of its blocks
    };
    /// A coded composite transport channel (CCTrCH).
    struct CompositeChannel {
        std::uint8_t identity;
        std::uint8_t timeslot;                 // its first
        std::array<double, kPositions> ratios; // dB, signal to interference
    };

    void begin(bool isData);
    void advance(double interferenceRatio, Random& random);

    std::span<const TransportChannel> transportChannels() const { return {channels.data(), channelCount}; }
    std::span<const CompositeChannel> compositeChannels() const
    {
        return {composites.data(), compositeCount};
    }

private:
    std::array<TransportChannel, 4> channels{};
    std::size_t channelCount = 0;
    std::array<CompositeChannel, 2> composites{};
    std::size_t compositeCount = 0;
};

} // namespace pelorus
