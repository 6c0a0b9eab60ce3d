#include "tests/recording/BytesBuilder.h"

namespace pelorus::test {

BytesBuilder& BytesBuilder::zeros(std::size_t count)
{
    for (; count > 0; --count)
        content.push_back(std::byte{0});
    return *this;
}

BytesBuilder& BytesBuilder::text(std::string_view characters)
{
    for (const char character : characters)
        content.push_back(static_cast<std::byte>(character));
    return *this;
}

BytesBuilder& BytesBuilder::raw(const Bytes& bytes)
{
    content.insert(content.end(), bytes.begin(), bytes.end());
    return *this;
}

BytesBuilder& BytesBuilder::put(std::size_t width, std::uint64_t value)
{
    for (std::size_t place = 0; place < width; ++place)
        content.push_back(static_cast<std::byte>(value >> (8 * place)));
    return *this;
}

Bytes startOf(const Bytes& bytes, std::size_t length)
{
    return {bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)};
}

Bytes record(unsigned code, std::string_view payload)
{
    const auto length = static_cast<unsigned>(12 + payload.size());
    return BytesBuilder().u16(length).u16(code).zeros(8).text(payload).bytes();
}

Bytes message(unsigned type, unsigned code, std::string_view payload)
{
    return BytesBuilder().u8(type).raw(record(code, payload)).bytes();
}

Bytes prefixed(const Bytes& message, unsigned second)
{
    return BytesBuilder().u8(0x81).u8(second).raw(message).bytes();
}

Bytes joined(const std::vector<Bytes>& messages)
{
    BytesBuilder all;
    for (const Bytes& one : messages)
        all.raw(one);
    return all.bytes();
}

} // namespace pelorus::test
