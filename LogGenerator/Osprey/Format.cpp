#include "LogGenerator/Osprey/Format.h"

#include <charconv>
#include <cstring>

namespace pelorus {

namespace {

constexpr std::size_t kLongestNumber = 32;

/// Writes value / Format::kOne; the number of decimals is a constant so that the divisions are none.
template <unsigned decimals> char* writeDecimals(char* place, std::int64_t value)
{
    constexpr std::uint64_t kUnit = decimals == 2 ? 100 : 1'000'000;
    constexpr std::uint64_t kDivisor = Format::kOne / kUnit;
    const auto bits = static_cast<std::uint64_t>(value);
    const std::uint64_t magnitude = value < 0 ? 0 - bits : bits;
    std::uint64_t rounded = magnitude / kDivisor;
    const std::uint64_t twiceTheRest = magnitude % kDivisor * 2;
    if (twiceTheRest > kDivisor || (twiceTheRest == kDivisor && rounded % 2 == 1))
        ++rounded;
    if (value < 0)
        *place++ = '-';
    place = std::to_chars(place, place + kLongestNumber, rounded / kUnit).ptr;
    *place = '.';
    std::uint64_t fraction = rounded % kUnit;
    for (unsigned digit = decimals; digit > 0; --digit, fraction /= 10)
        place[digit] = static_cast<char>('0' + fraction % 10);
    return place + decimals + 1;
}

} // namespace

/// One text in the making, on the stack.
class Format::Text {
public:
    explicit Text(const Format& given) : format(given)
    {
        std::memcpy(row.data(), format.prefix.text.data(), kRoom);
    }
    char* number() { return row.data() + format.prefix.length; }
    char* numberEnd() { return number() + kLongestNumber; }
    void finish(std::string& out, char* end)
    {
        std::memcpy(end, format.suffix.text.data(), kRoom);
        out.assign(row.data(), static_cast<std::size_t>(end - row.data()) + format.suffix.length);
    }

private:
    const Format& format;
    std::array<char, kRoom + kLongestNumber + kRoom> row;
};

void Format::write(std::string& out, std::int64_t value) const
{
    const auto low = static_cast<std::uint32_t>(value);
    Text text(*this);
    text.finish(
        out, isUnsigned ? std::to_chars(text.number(), text.numberEnd(), low).ptr
                        : std::to_chars(text.number(), text.numberEnd(), static_cast<std::int32_t>(low)).ptr);
}

void Format::writeFixed(std::string& out, std::int64_t value) const
{
    Text text(*this);
    text.finish(out, hasSixDecimals ? writeDecimals<6>(text.number(), value)
                                    : writeDecimals<2>(text.number(), value));
}

} // namespace pelorus
