#include "platform/linux/FrameReader.h"

#include <algorithm>
#include <cstring>

namespace pelorus {

namespace {

constexpr std::size_t kUsualSize = 64 * 1024;

} // namespace

FrameReader::FrameReader()
{
    moveTo(kUsualSize);
}

void FrameReader::moveTo(std::size_t newSize)
{
    auto target = std::make_unique_for_overwrite<std::byte[]>(newSize);
    if (begin != end)
        std::memcpy(target.get(), buffer.get() + begin, end - begin);
    buffer = std::move(target);
    size = newSize;
    end -= begin;
    begin = 0;
}

std::span<std::byte> FrameReader::room()
{
    // Bytes move at most once a frame, and twice as far each time the buffer grows: linear in the stream.
    const std::size_t needed = header ? header->payloadLength : FrameHeader::size;
    if (begin == end)
        begin = end = 0;
    if (size > kUsualSize && needed <= kUsualSize && end - begin <= kUsualSize / 2) {
        moveTo(kUsualSize); // a large frame is done
    } else if (begin > 0 && begin + needed > size) {
        std::memmove(buffer.get(), buffer.get() + begin, end - begin);
        end -= begin;
        begin = 0;
    }
    if (end == size)
        moveTo(std::min(2 * size, std::max(needed, size + 1)));
    return {buffer.get() + end, size - end};
}

std::optional<Frame> FrameReader::next()
{
    if (cutOff)
        return std::nullopt;
    if (!header) {
        if (end - begin < FrameHeader::size)
            return std::nullopt;
        FrameHeader parsed;
        if (!parsed.parse(
                std::span<const std::byte, FrameHeader::size>(buffer.get() + begin, FrameHeader::size),
                why)) {
            cutOff = true;
            return std::nullopt;
        }
        begin += FrameHeader::size;
        header = parsed;
    }
    if (end - begin < header->payloadLength)
        return std::nullopt;
    Frame frame = header->frame;
    frame.payload = {buffer.get() + begin, header->payloadLength};
    begin += header->payloadLength;
    header.reset();
    return frame;
}

} // namespace pelorus
