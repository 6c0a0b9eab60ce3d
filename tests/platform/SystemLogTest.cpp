#include "platform/SystemLog.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <string>

namespace pelorus {
namespace {

class RecordingSink : public SystemLogSink {
public:
    void write(int priority, std::string_view text) override
    {
        lines += std::to_string(priority) + ":" + std::string(text) + "|";
    }
    std::string lines;
};

class SystemLog : public testing::Test {
protected:
    SystemLog() : previous(setSystemLogSink(&sink)) {}
    ~SystemLog() override { setSystemLogSink(previous); }

    RecordingSink sink;
    SystemLogSink* previous;
};

TEST_F(SystemLog, PassesPriorityAndTextWithItsLineFeed)
{
    systemLog(kLogError, "Failed\n");
    systemLog(kLogWarning, " leading blank");
    systemLog(7, "100%%");
    EXPECT_EQ(sink.lines, "3:Failed\n|4: leading blank|7:100%|");
}

TEST_F(SystemLog, FormatsAsPrintfDoes)
{
    const std::string text = "string";
    const char* const letters = "letters";
    systemLog(5, "%s %s %s", text, letters, "literal");
    systemLog(5, "%d %u %x %02X %5d", -1, 4294967295U, 48879, 10, 42);
    systemLog(5, "%ld %lu %lx", std::int64_t{-9000000000}, std::size_t{9000000000},
              std::uint64_t{0xABCDEF0123});
    systemLog(5, "%lf %.2f", 0.5, -1.005);
    systemLog(5, "%p", reinterpret_cast<void*>(std::uintptr_t{0x7ffe12}));
    systemLog(5, "%c%%", 'x');
    EXPECT_EQ(sink.lines, "5:string letters literal|"
                          "5:-1 4294967295 beef 0A    42|"
                          "5:-9000000000 9000000000 abcdef0123|"
                          "5:0.500000 -1.00|"
                          "5:0x7ffe12|"
                          "5:x%|");
}

TEST_F(SystemLog, FormatsNothingWhenNobodyListens)
{
    EXPECT_TRUE(systemLogListens());
    EXPECT_THROW(systemLog(3, "%d", "no number"), fmt::format_error);
    EXPECT_EQ(setSystemLogSink(nullptr), &sink);
    EXPECT_FALSE(systemLogListens());
    EXPECT_NO_THROW(systemLog(3, "%d", "no number"));
    EXPECT_EQ(sink.lines, "");
}

} // namespace
} // namespace pelorus
