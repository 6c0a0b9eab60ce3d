#pragma once

#include "telephonyd/simulation/LogTime.h"
#include "telephonyd/simulation/PacketWriter.h"

#include <span>

namespace pelorus {

/// One log message of a simulated handset.
struct SimulatedMessage {
    std::chrono::nanoseconds time{}; // since the simulation began
    std::uint32_t code = 0;          // of the log, 0xFF0000 and up for the telephony server's own; 0 for none
    std::span<const std::byte> bytes;
};

/// What a handset logs in one step of its life, in order. The memory is used again for the next step.
class MessageBatch {
public:
    explicit MessageBatch(HandsetTime begin) : start(begin) {}

    /// The time of the messages that follow, since the start.
    void setTime(std::chrono::nanoseconds since) { now = since; }
    std::chrono::nanoseconds time() const { return now; }
    /// A packet of the baseband, all 0 behind its header. The writer holds until the next message.
    PacketWriter packet(std::uint16_t code, std::size_t length);
    /// A packet of the telephony server itself: `code` is 0xFF0000 and up, a serialized property list its
    /// payload.
    void list(std::uint32_t code, std::span<const std::byte> propertyList);
    /// A message without a header, of a baseband that knows no log codes; its code is 0.
    void bare(std::span<const std::byte> content);

    std::size_t size() const { return messages.size(); }
    /// Valid until the batch changes.
    SimulatedMessage operator[](std::size_t index) const;
    void clear();

private:
    struct Entry {
        std::chrono::nanoseconds time;
        std::uint32_t code;
        std::size_t start;
        std::size_t length;
    };

    /// Makes room for a message behind the others; where it begins.
    std::size_t append(std::uint32_t code, std::size_t length);
    std::size_t begin(std::uint32_t code, std::size_t length);

    HandsetTime start;
    std::chrono::nanoseconds now{};
    std::vector<std::byte> bytes;
    std::vector<Entry> messages;
};

} // namespace pelorus
