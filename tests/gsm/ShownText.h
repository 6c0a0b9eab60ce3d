#pragma once

#include "LogGenerator/Osprey/LogPacket.h"

#include <gtest/gtest.h>
#include <initializer_list>
#include <ostream>
#include <utility>
#include <vector>

namespace pelorus::test {

/// What one row shows for one value of one byte.
struct ShownText {
    const char* section;
    LogCode code;
    std::size_t length;
    std::size_t offset;
    const char* row;
    unsigned value;
    const char* text;

    friend std::ostream& operator<<(std::ostream& out, const ShownText& shown)
    {
        return out << shown.section << ", " << shown.row << ", " << shown.value;
    }
};

/// Packets of zeros but for the one byte. The sections' own tests say the values.
class ShownTextOf : public testing::TestWithParam<ShownText> {};

inline auto shownTexts(const char* section, LogCode code, std::size_t length, std::size_t offset,
                       const char* row, std::initializer_list<std::pair<unsigned, const char*>> texts)
{
    std::vector<ShownText> cases;
    for (const auto& [value, text] : texts)
        cases.push_back({section, code, length, offset, row, value, text});
    return testing::ValuesIn(cases);
}

} // namespace pelorus::test
