#pragma once

#include "telephonyd/simulation/MessageBatch.h"
#include "telephonyd/simulation/Random.h"

#include <array>

namespace pelorus {

/// What goes over the transport channels of a UMTS connection: block errors, and the HARQ processes of HSDPA
/// while data flows. Counters begin anew with each connection, and grow.
class UmtsTraffic {
public:
    enum class Kind { voice, data };

    void begin(Kind kind, Random& random);
    /// `ecio` of the best cell decides how much fits into a block, and how often it is lost.
    void advance(double seconds, double ecio, Random& random);
    bool isData() const { return kind == Kind::data; }

    /// 0x4221.
    void writeHarq(MessageBatch& log) const;
    /// 0x4116.
    void writeBlockErrors(MessageBatch& log) const;

private:
    static constexpr std::size_t kProcesses = 6; // of a carrier

    struct Process {
        double receivedBits = 0;
        double newTransmissions = 0;
        double blockErrors = 0;
    };
    struct Channel {
        std::uint8_t identity = 0;
        double blocksPerSecond = 0;
        double received = 0;
        double inError = 0;
    };

    void transmit(Process& process, double blocks, double ecio, Random& random);

    Kind kind = Kind::voice;
    std::size_t carriers = 1;
    double reportedTime = 0; // seconds of the last step
    std::array<std::array<Process, kProcesses>, 2> processes{};
    std::array<Channel, 2> channels{};
};

} // namespace pelorus
