#pragma once

#include "platform/linux/Frame.h"

#include <memory>
#include <optional>

namespace pelorus {

/// Cuts a stream into frames. Bytes are read straight into room(), and payloads are views of where they lie.
/// The buffer grows as a large frame's bytes arrive (not when they are announced), up to one maximal frame,
/// and shrinks again when that frame is done.
class FrameReader {
public:
    FrameReader();

    /// Where the next bytes of the stream go; never empty. Ends the life of every payload handed out.
    std::span<std::byte> room();
    /// The first `count` bytes of room() are there now.
    void received(std::size_t count) { end += count; }
    /// The next whole frame, if it is there.
    std::optional<Frame> next();

    /// The stream broke the rules: no frame comes any more, and the peer is to be cut off.
    bool isCutOff() const { return cutOff; }
    /// In which way, in one line.
    const std::string& reason() const { return why; }
    /// The stream may end here: no frame has begun.
    bool isBetweenFrames() const { return begin == end && !header; }
    std::size_t capacity() const { return size; }

private:
    void moveTo(std::size_t newSize);

    std::unique_ptr<std::byte[]> buffer;
    std::size_t size = 0;
    std::size_t begin = 0; // of what is not handed out yet
    std::size_t end = 0;
    std::optional<FrameHeader> header; // of the frame whose payload is incomplete
    bool cutOff = false;
    std::string why;
};

} // namespace pelorus
