#pragma once

#include "bench/MessageStream.h"

#include <cstring>

namespace pelorus::bench {

/// The least that decoding takes: the log code looked up in a table, and three fields read of each message.
class Dispatch {
public:
    /// Knows the log codes of the stream, each with fields at places of its own.
    explicit Dispatch(const MessageStream& stream)
    {
        constexpr Handler handlers[] = {threeFields<13, 16, 20>, threeFields<14, 17, 19>,
                                        threeFields<13, 15, 18>, threeFields<15, 17, 20>,
                                        threeFields<14, 16, 18>};
        std::size_t known = 0;
        for (std::size_t index = 0; index < stream.size(); ++index)
            if (Handler& handler = table[slotOf(stream[index])]; handler == nullptr)
                handler = handlers[known++ % std::size(handlers)];
    }

    /// The sum of all fields that it read.
    std::uint64_t walk(std::span<const std::byte> stream) const
    {
        std::uint64_t sum = 0;
        for (; stream.size() >= kHeaderLength;) {
            const std::size_t length = 1 + word(stream, 1);
            if (length < kHeaderLength || length > stream.size())
                break;
            const auto packet = stream.first(length);
            if (const Handler handler = table[slotOf(packet)])
                sum += handler(packet);
            stream = stream.subspan(length);
        }
        return sum;
    }

private:
    using Handler = std::uint64_t (*)(std::span<const std::byte>);

    static constexpr std::size_t kHeaderLength = 13;

    static std::size_t word(std::span<const std::byte> bytes, std::size_t place)
    {
        std::uint16_t value = 0;
        std::memcpy(&value, bytes.data() + place, sizeof value);
        return value;
    }

    /// Log types are the baseband's, 1, and the telephony server's, 255.
    static std::size_t slotOf(std::span<const std::byte> packet)
    {
        return word(packet, 3) | std::to_integer<std::size_t>(packet[0] >> 7) << 16;
    }

    template <std::size_t A, std::size_t B, std::size_t C>
    static std::uint64_t threeFields(std::span<const std::byte> packet)
    {
        return packet.size() < C + 2 ? 0 : word(packet, A) + word(packet, B) + word(packet, C);
    }

    std::vector<Handler> table = std::vector<Handler>(1 << 17);
};

} // namespace pelorus::bench
