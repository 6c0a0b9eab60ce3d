#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

namespace pelorus::test {

using Bytes = std::vector<std::byte>;

/// Bytes one behind the other; integers are little-endian.
class BytesBuilder {
public:
    BytesBuilder& u8(unsigned value) { return put(1, value); }
    BytesBuilder& u16(unsigned value) { return put(2, value); }
    BytesBuilder& u32(std::uint64_t value) { return put(4, value); }
    BytesBuilder& u64(std::uint64_t value) { return put(8, value); }
    BytesBuilder& zeros(std::size_t count);
    BytesBuilder& text(std::string_view characters);
    BytesBuilder& raw(const Bytes& bytes);
    const Bytes& bytes() const { return content; }

private:
    BytesBuilder& put(std::size_t width, std::uint64_t value);

    Bytes content;
};

/// The first so many of the bytes.
Bytes startOf(const Bytes& bytes, std::size_t length);

/// A log record: its length, a log code, a time stamp of 0, a payload.
Bytes record(unsigned code, std::string_view payload = "");
/// A message: log type, record.
Bytes message(unsigned type, unsigned code, std::string_view payload = "");
/// A message behind the 2-byte prefix.
Bytes prefixed(const Bytes& message, unsigned second = 0);
/// Messages one behind the other.
Bytes joined(const std::vector<Bytes>& messages);

} // namespace pelorus::test
