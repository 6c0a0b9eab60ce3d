// A port's stream, in pieces of any length: the frames are those that the stream holds, a peer that breaks
// the rules is cut off behind the last good one, and nothing depends on the pieces.
//
// The input: a byte of how many lengths of pieces follow, those, and the stream.

#include "platform/linux/FrameReader.h"

#include "fuzz/Input.h"
#include "fuzz/Require.h"

#include <cstring>

using namespace pelorus;
using namespace pelorus::fuzz;

namespace {

struct Message {
    std::int32_t id;
    std::uint32_t kind;
    std::uint32_t sequence;
    bool hasData;
    std::vector<std::byte> payload;
    friend bool operator==(const Message&, const Message&) = default;
};

struct Outcome {
    std::vector<Message> messages;
    bool cutOff = false;
    bool isBetweenFrames = true;
    friend bool operator==(const Outcome&, const Outcome&) = default;
};

std::uint32_t number(std::span<const std::byte> bytes, std::size_t offset)
{
    std::uint32_t value = 0;
    for (std::size_t index = 0; index < 4; ++index)
        value |= std::to_integer<std::uint32_t>(bytes[offset + index]) << (8 * index);
    return value;
}

/// Straight from the rules: u32 length, i32 id, u32 kind, u32 sequence; 0xFFFFFFFF is a reply without data.
Outcome outcomeOf(std::span<const std::byte> stream)
{
    Outcome outcome;
    while (stream.size() >= 16) {
        const std::uint32_t length = number(stream, 0);
        const std::uint32_t kind = number(stream, 8);
        const bool hasData = length != 0xFFFFFFFF;
        if (kind > 2 || (hasData ? length > 16 * 1024 * 1024 : kind != 2)) {
            outcome.cutOff = true;
            return outcome;
        }
        const std::size_t payload = hasData ? length : 0;
        if (stream.size() - 16 < payload)
            break;
        const auto bytes = stream.subspan(16, payload);
        outcome.messages.push_back({static_cast<std::int32_t>(number(stream, 4)),
                                    kind,
                                    number(stream, 12),
                                    hasData,
                                    {bytes.begin(), bytes.end()}});
        stream = stream.subspan(16 + payload);
    }
    outcome.isBetweenFrames = stream.empty();
    return outcome;
}

Outcome read(std::span<const std::byte> stream, std::span<const std::byte> pieces)
{
    FrameReader reader;
    Outcome outcome;
    std::size_t turn = 0;
    while (!stream.empty() && !reader.isCutOff()) {
        const auto room = reader.room();
        require(!room.empty(), "there is room");
        const std::size_t wanted =
            pieces.empty() ? stream.size() : std::to_integer<std::size_t>(pieces[turn++ % pieces.size()]) + 1;
        const std::size_t count = std::min({wanted, room.size(), stream.size()});
        std::memcpy(room.data(), stream.data(), count);
        std::memset(room.data() + count, 0xA5, room.size() - count);
        reader.received(count);
        stream = stream.subspan(count);
        while (const auto frame = reader.next())
            outcome.messages.push_back({frame->id,
                                        static_cast<std::uint32_t>(frame->kind),
                                        frame->sequence,
                                        frame->hasData,
                                        {frame->payload.begin(), frame->payload.end()}});
    }
    outcome.cutOff = reader.isCutOff();
    outcome.isBetweenFrames = outcome.cutOff || reader.isBetweenFrames();
    require(outcome.cutOff != reader.reason().empty(), "a peer that is cut off is told why in the log");
    require(!reader.next(), "no frame comes any more");
    return outcome;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    Input input(data, size);
    const auto pieces = input.take(input.byte());
    const std::vector<std::byte> stream = input.copy(size);
    const Outcome outcome = outcomeOf(stream);
    require(read(stream, pieces) == outcome, "a stream in pieces gives its frames");
    require(read(stream, {}) == outcome, "a stream as a whole gives its frames");
    return 0;
}
