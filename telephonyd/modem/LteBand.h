#pragma once

#include <cstdint>
#include <optional>

namespace pelorus {

/// The operating band of a downlink carrier (3GPP TS 36.101, table 5.7.3-1).
std::optional<int> lteBand(std::uint32_t earfcn);

/// The band that a value of ModemManager's CurrentBands stands for; nothing when it is none of LTE.
std::optional<int> lteBandOfModem(std::uint32_t modemBand);

} // namespace pelorus
