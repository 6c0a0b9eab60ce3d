#pragma once

#include "telephonyd/simulation/Drift.h"

#include <array>
#include <cstdint>

namespace pelorus {

class MessageBatch;

/// What goes over the air of an EV-DO connection, counted in packets of each size since the handset was
/// switched on. Pages are loaded and read, and now and then something is sent back.
class EvdoLink {
public:
    explicit EvdoLink(Random& random) : share(random) {}

    /// `ratio` is the C/I of the serving sector, `reserve` what the transmitter could still add, both in dB.
    void advance(double seconds, double ratio, double reserve, Random& random);

    /// 0x1192 and 0x127E. The sequence numbers count the seconds.
    void write(MessageBatch& log, std::uint32_t sequenceNumber) const;

private:
    enum class Demand { none, down, up };

    void changeDemand(double seconds, Random& random);
    void receive(double seconds, double ratio, Random& random);
    void send(double seconds, double reserve, Random& random);

    static constexpr std::size_t kForwardCounters = 56;
    static constexpr std::size_t kPayloads = 12;
    static constexpr std::size_t kSubpackets = 4; // of a reverse-link packet, at most

    Drift share; // of the sector's time that is for this handset
    Demand demand = Demand::none;
    double demandEnds = 0; // seconds from now
    std::array<std::uint32_t, kForwardCounters> forward{};
    /// By payload, and by the subpacket with which it was through.
    std::array<std::array<std::uint32_t, kSubpackets>, kPayloads> reverse{};
};

} // namespace pelorus
