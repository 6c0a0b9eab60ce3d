#include "telephonyd/modem/ThreeGppLocation.h"

#include <algorithm>
#include <array>
#include <charconv>

namespace pelorus {

namespace {

std::optional<int> digitsOf(std::string_view text, std::size_t least, std::size_t most)
{
    if (text.size() < least || text.size() > most ||
        !std::ranges::all_of(text, [](char digit) { return digit >= '0' && digit <= '9'; }))
        return std::nullopt;
    int number = 0;
    std::from_chars(text.data(), text.data() + text.size(), number);
    return number;
}

std::optional<std::uint32_t> unlessZero(std::optional<std::uint32_t> number)
{
    return number == 0U ? std::nullopt : number;
}

} // namespace

std::optional<std::uint32_t> hexNumber(std::string_view text, std::uint32_t most)
{
    std::uint64_t number = 0;
    const char* const last = text.data() + text.size();
    const auto [end, error] = std::from_chars(text.data(), last, number, 16);
    if (error != std::errc() || end != last || number > most)
        return std::nullopt;
    return static_cast<std::uint32_t>(number);
}

OperatorCode OperatorCode::parse(std::string_view digits)
{
    OperatorCode code;
    if (digits.size() < 5 || digits.size() > 6)
        return code;
    code.countryCode = digitsOf(digits.substr(0, 3), 3, 3);
    code.networkCode = digitsOf(digits.substr(3), 2, 3);
    if (!code.countryCode || !code.networkCode)
        return {};
    return code;
}

ThreeGppLocation ThreeGppLocation::parse(std::string_view text)
{
    std::array<std::string_view, 5> fields;
    for (std::string_view& field : fields) {
        const std::size_t comma = std::min(text.find(','), text.size());
        field = text.substr(0, comma);
        text.remove_prefix(std::min(comma + 1, text.size()));
    }
    ThreeGppLocation location;
    location.countryCode = digitsOf(fields[0], 3, 3);
    location.networkCode = digitsOf(fields[1], 2, 3);
    location.locationArea = unlessZero(hexNumber(fields[2], kMostAreaCode));
    location.cellIdentity = unlessZero(hexNumber(fields[3], kMostCellIdentity));
    location.trackingArea = unlessZero(hexNumber(fields[4], kMostAreaCode));
    return location;
}

} // namespace pelorus
