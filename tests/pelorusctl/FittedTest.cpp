#include "pelorusctl/Screen.h"

#include <clocale>
#include <gtest/gtest.h>

namespace pelorus {

/// The program's texts are UTF-8 on any screen.
class FittedTest : public testing::Test {
protected:
    FittedTest() { std::setlocale(LC_CTYPE, "C.UTF-8"); }

    /// The fitted text and the columns it takes, as "text|columns".
    static std::string fit(std::string_view text, std::size_t columns)
    {
        std::size_t used = 999;
        const std::string shown = fitted(text, columns, used);
        return shown + "|" + std::to_string(used);
    }
};

TEST_F(FittedTest, KeepsWhatFits)
{
    EXPECT_EQ(fit("", 0), "|0");
    EXPECT_EQ(fit("", 5), "|0");
    EXPECT_EQ(fit("RSRP", 4), "RSRP|4");
    EXPECT_EQ(fit("RSRP", 80), "RSRP|4");
}

TEST_F(FittedTest, EndsInAnEllipsisWhereItCuts)
{
    EXPECT_EQ(fit("RSRP", 3), "RS…|3");
    EXPECT_EQ(fit("RSRP", 1), "…|1");
    EXPECT_EQ(fit("RSRP", 0), "|0");
}

TEST_F(FittedTest, CountsWideCharactersTwice)
{
    EXPECT_EQ(fit("東京駅", 6), "東京駅|6");
    EXPECT_EQ(fit("東京駅", 5), "東京…|5");
    EXPECT_EQ(fit("東京駅", 4), "東…|3"); // half a character cannot be shown
    EXPECT_EQ(fit("東京駅", 2), "…|1");
    EXPECT_EQ(fit("東", 1), "…|1");
}

TEST_F(FittedTest, KeepsCombiningMarksWithTheirLetter)
{
    EXPECT_EQ(fit("e\u0301te\u0301", 3), "e\u0301te\u0301|3");
    EXPECT_EQ(fit("e\u0301te\u0301", 2), "e\u0301…|2");
}

TEST_F(FittedTest, ShowsAQuestionMarkForWhatIsNoCharacter)
{
    EXPECT_EQ(fit("a\xFF\xC3", 9), "a??|3");
    EXPECT_EQ(fit("\xE2\x82", 9), "??|2");
    EXPECT_EQ(fit("a\x1b[0m\u009b", 9), "a?[0m?|6");
    EXPECT_EQ(fit(std::string_view("a\0b", 3), 9), "a?b|3");
    EXPECT_EQ(fit("\xFF\xFF\xFF", 2), "?…|2");
}

} // namespace pelorus
