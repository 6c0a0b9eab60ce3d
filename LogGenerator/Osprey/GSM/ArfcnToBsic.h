#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

namespace pelorus {

/// GSM channel to base-station identity code. A table by channel: it is asked for every neighbour of every
/// measurement.
class ArfcnToBsic {
public:
    void clear()
    {
        for (const std::uint16_t arfcn : known)
            bsics[arfcn] = kUnknown;
        known.clear();
    }
    void set(std::uint16_t arfcn, std::uint8_t bsic)
    {
        if (arfcn >= bsics.size())
            bsics.resize(std::size_t{arfcn} + 1, kUnknown);
        bsics[arfcn] = bsic;
        known.push_back(arfcn);
    }
    std::optional<std::uint8_t> find(std::uint16_t arfcn) const
    {
        if (arfcn >= bsics.size() || bsics[arfcn] == kUnknown)
            return std::nullopt;
        return static_cast<std::uint8_t>(bsics[arfcn]);
    }

private:
    static constexpr std::int16_t kUnknown = -1;
    std::vector<std::int16_t> bsics;
    std::vector<std::uint16_t> known; // what clear() has to undo
};

} // namespace pelorus
