#include "platform/Platform.h"

#include <gtest/gtest.h>

namespace pelorus {
namespace {

TEST(DateText, IsUtcWithoutTheFraction)
{
    const auto text = [](std::int64_t milliseconds) {
        return dateText(std::chrono::system_clock::time_point(std::chrono::milliseconds(milliseconds)));
    };
    EXPECT_EQ(text(1336123800000), "2012-05-04 09:30:00 +0000");
    EXPECT_EQ(text(1336123800999), "2012-05-04 09:30:00 +0000");
    EXPECT_EQ(text(-1), "1969-12-31 23:59:59 +0000");
}

} // namespace
} // namespace pelorus
