#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace pelorus {

/// Where the modem is in its network, as far as it knows.
struct ThreeGppLocation {
    std::optional<int> countryCode;
    std::optional<int> networkCode;
    std::optional<std::uint32_t> locationArea;
    std::optional<std::uint32_t> trackingArea;
    std::optional<std::uint32_t> cellIdentity;

    /// ModemManager's text: "MCC,MNC,LAC,CI,TAC", the last three hexadecimal, older ones without the TAC.
    /// What is empty, 0 or out of range is not known.
    static ThreeGppLocation parse(std::string_view text);
};

/// A mobile country and network code, five or six digits.
struct OperatorCode {
    std::optional<int> countryCode;
    std::optional<int> networkCode;

    static OperatorCode parse(std::string_view digits);
};

/// A hexadecimal number without prefix. Nothing when it is none, or above `most`.
std::optional<std::uint32_t> hexNumber(std::string_view text, std::uint32_t most);

constexpr std::uint32_t kMostCellIdentity = 0xFFFFFFF; // 28 bits
constexpr std::uint32_t kMostAreaCode = 0xFFFD;        // above it is what means that there is none

} // namespace pelorus
