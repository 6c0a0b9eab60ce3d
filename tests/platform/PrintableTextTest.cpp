#include "platform/PrintableText.h"

#include <gtest/gtest.h>

namespace pelorus {

TEST(Printable, LeavesNothingThatSteersATerminal)
{
    EXPECT_EQ(printable("\x1b[2J\x7f"), "\\x1b[2J\\x7f");
    EXPECT_EQ(printable(std::string_view("a\0b", 3)), "a\\x00b");
    // U+0080, U+009B (a terminal's ESC [) and U+009F
    EXPECT_EQ(printable("\xC2\x80\xC2\x9B"
                        "31m\xC2\x9F"),
              "\\x80\\x9b31m\\x9f");
}

TEST(Printable, LeavesTextAsItIs)
{
    EXPECT_EQ(printable(""), "");
    EXPECT_EQ(printable("-85 dBm\\n"), "-85 dBm\\n");
    // U+00A0, e acute, U+20AC, U+1F4F6
    EXPECT_EQ(printable("\xC2\xA0\xC3\xA9\xE2\x82\xAC\xF0\x9F\x93\xB6"),
              "\xC2\xA0\xC3\xA9\xE2\x82\xAC\xF0\x9F\x93\xB6");
}

TEST(Printable, EscapesBytesThatAreNoUtf8)
{
    EXPECT_EQ(printable("\x9B"
                        "31m\xFF"),
              "\\x9b31m\\xff");
    EXPECT_EQ(printable("caf\xC3"), "caf\\xc3");
    EXPECT_EQ(printable("\xE2\x82x\n"), "\\xe2\\x82x\\n");
    EXPECT_EQ(printable("\xED\xA0\x80\xC3\xA9"), "\\xed\\xa0\\x80\xC3\xA9"); // a surrogate
}

} // namespace pelorus
