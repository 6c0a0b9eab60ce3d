#include "tests/c2k/C2KFixture.h"

#include <limits>

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class LinkDataRates : public C2KFixture {
protected:
    LinkDataRates() : C2KFixture({"kFLDataRate", "kRLDataRate"}) {}

    static PacketBuilder forward(std::uint64_t sequenceNumber)
    {
        return PacketBuilder(241).u32(13, sequenceNumber);
    }
    static PacketBuilder reverse(std::uint64_t sequenceNumber)
    {
        return PacketBuilder(1750).u32(14, sequenceNumber);
    }
    std::int64_t kept(std::string_view key) { return state.find(key) ? *state.at(key).integer() : -1; }
    std::string extraInfo() { return textOfNumbers(*state.at("ExtraInfo").dictionary()); }
    static std::string textOfNumbers(const Dictionary& numbers)
    {
        std::string text;
        for (const auto& [key, number] : numbers)
            text += fmt::format("{}={} ", key.text(), *number.integer());
        return text;
    }
};

// By the number of the counter.
constexpr int kForwardWeights[56] = {128,  256,  512,  1024, 0,    128, 256,  512,  1024, 0,    128, 256,
                                     512,  1024, 0,    128,  256,  512, 1024, 0,    128,  256,  512, 1024,
                                     0,    512,  1024, 2048, 0,    128, 256,  512,  1024, 0,    512, 1024,
                                     2048, 0,    1024, 3072, 0,    512, 1024, 2048, 0,    4096, 0,   1024,
                                     3072, 0,    4096, 0,    5120, 0,   5120, 0};
constexpr int kReverseWeights[12] = {128, 256, 512, 768, 1024, 1536, 2048, 3072, 4096, 6144, 8192, 12288};

TEST_F(LinkDataRates, TheFirstPacketOnlyPrimes)
{
    receive(0x1192, forward(10).u32(17, 3));
    EXPECT_EQ(row("kFLDataRate"), "");
    EXPECT_EQ(kept("FLDataSeqNum"), 10);
    EXPECT_EQ(kept("FLDataSent"), 384);
    EXPECT_EQ(extraInfo(), "FLDataSeqNum1=10 FLDataSent1=384 ");
    receive(0x127E, reverse(20).u32(18, 2));
    EXPECT_EQ(row("kRLDataRate"), "");
    EXPECT_EQ(kept("RLDataSeqNum"), 20);
    EXPECT_EQ(kept("RLDataSent"), 256);
    EXPECT_EQ(extraInfo(), "FLDataSeqNum1=10 FLDataSent1=384 RLDataSeqNum1=20 RLDataSent1=256 ");
}

TEST_F(LinkDataRates, TheRateIsWhatCameSinceForEachStep)
{
    receive(0x1192, forward(10));
    receive(0x1192, forward(12).u32(29, 307)); // 307 of 1024 in 2 steps
    EXPECT_EQ(row("kFLDataRate"), "153.50 kbps");
    EXPECT_EQ(extraInfo(), "FLDataSeqNum1=12 FLDataSent1=314368 FLDataSeqNum2=10 FLDataSent2=0 ");
    receive(0x1192, forward(13).u32(29, 307));
    EXPECT_EQ(row("kFLDataRate"), "0.00 kbps");
    receive(0x127E, reverse(10));
    receive(0x127E, reverse(13).u32(18, 10)); // 10 of 128 in 3 steps
    EXPECT_EQ(row("kRLDataRate"), "0.42 kbps");
    EXPECT_EQ(kept("RLDataSent"), 1280);
}

TEST_F(LinkDataRates, ACounterThatFellGivesANegativeRate)
{
    receive(0x1192, forward(1).u32(29, 4));
    receive(0x1192, forward(2).u32(29, 1));
    EXPECT_EQ(row("kFLDataRate"), "-3.00 kbps");
}

TEST_F(LinkDataRates, NoStepLeavesTheRateButNotTheCounters)
{
    receive(0x1192, forward(10));
    receive(0x1192, forward(11).u32(29, 1));
    EXPECT_EQ(row("kFLDataRate"), "1.00 kbps");
    receive(0x1192, forward(11).u32(29, 5));
    EXPECT_EQ(row("kFLDataRate"), "1.00 kbps");
    EXPECT_EQ(extraInfo(), "FLDataSeqNum1=11 FLDataSent1=5120 FLDataSeqNum2=11 FLDataSent2=1024 ");
    receive(0x1192, forward(9).u32(29, 6)); // backwards
    EXPECT_EQ(row("kFLDataRate"), "1.00 kbps");
    EXPECT_EQ(kept("FLDataSeqNum"), 9);
    EXPECT_EQ(kept("FLDataSent"), 6144);
    receive(0x127E, reverse(10).u32(18, 8));
    receive(0x127E, reverse(10).u32(18, 16));
    EXPECT_EQ(row("kRLDataRate"), "");
    EXPECT_EQ(kept("RLDataSent"), 2048);
}

TEST_F(LinkDataRates, SequenceNumbersGoRoundIn32Bits)
{
    receive(0x1192, forward(0xFFFFFFFF));
    EXPECT_EQ(kept("FLDataSeqNum"), 4294967295);
    receive(0x1192, forward(1).u32(29, 4));
    EXPECT_EQ(row("kFLDataRate"), "2.00 kbps");
    receive(0x1192, forward(0x80000000).u32(29, 4)); // 0x7FFFFFFF steps
    EXPECT_EQ(row("kFLDataRate"), "0.00 kbps");
    receive(0x1192, forward(0).u32(29, 1000)); // 0x80000000 is a negative number of steps
    EXPECT_EQ(row("kFLDataRate"), "0.00 kbps");
    EXPECT_EQ(kept("FLDataSent"), 1024000);
    receive(0x127E, reverse(0xFFFFFFFE));
    receive(0x127E, reverse(0).u32(18, 16));
    EXPECT_EQ(row("kRLDataRate"), "1.00 kbps");
}

TEST_F(LinkDataRates, ForwardCountersHaveTheirWeights)
{
    for (unsigned counter = 0; counter < 56; ++counter) {
        receive(0x1192, forward(1).u32(17 + 4 * counter, 1));
        EXPECT_EQ(kept("FLDataSent"), kForwardWeights[counter]) << counter;
    }
}

TEST_F(LinkDataRates, ReverseCountersHaveTheWeightOfTheirRate)
{
    for (unsigned block = 0; block < 3; ++block)
        for (unsigned rate = 0; rate < 12; ++rate)
            for (const unsigned place : {18U, 22U, 26U, 30U, 306U, 310U, 314U, 318U}) {
                receive(0x127E, reverse(1).u32(576 * block + 24 * rate + place, 1));
                EXPECT_EQ(kept("RLDataSent"), kReverseWeights[rate])
                    << block << ", " << rate << ", " << place;
            }
    receive(0x127E, reverse(1).u32(34, 1).u32(38, 1).u32(1742, 1)); // between and behind the counters
    EXPECT_EQ(kept("RLDataSent"), 0);
}

TEST_F(LinkDataRates, TotalsHave64Bits)
{
    PacketBuilder full = forward(1);
    for (unsigned counter = 0; counter < 56; ++counter)
        full.u32(17 + 4 * counter, 0xFFFFFFFF);
    receive(0x1192, forward(0));
    receive(0x1192, full);
    EXPECT_EQ(kept("FLDataSent"), 210006720856320); // 48896 * 4294967295
    EXPECT_EQ(row("kFLDataRate"), "205084688336.25 kbps");
    PacketBuilder fullReverse = reverse(1);
    for (unsigned place = 18; place + 4 <= 1750; place += 4)
        fullReverse.u32(place, 0xFFFFFFFF);
    receive(0x127E, fullReverse);
    EXPECT_EQ(kept("RLDataSent"), 4129765672965120); // 24 * 40064 * 4294967295
}

TEST_F(LinkDataRates, DifferencesGoRoundIn64Bits)
{
    receive(0x1192, forward(0));
    state.set(Label("FLDataSent"), std::numeric_limits<std::int64_t>::min());
    receive(0x1192, forward(1));
    EXPECT_EQ(row("kFLDataRate"), "-9007199254740992.00 kbps");
    state.set(Label("FLDataSent"), std::numeric_limits<std::int64_t>::max());
    receive(0x1192, forward(2).u32(17, 1));
    EXPECT_EQ(row("kFLDataRate"), "-9007199254740992.00 kbps"); // 128 - (2^63 - 1), rounded
}

TEST_F(LinkDataRates, WithoutBothValuesOfThePacketBeforeTheRowIsEmpty)
{
    receive(0x1192, forward(1));
    receive(0x1192, forward(2).u32(29, 1));
    state.remove("FLDataSent");
    receive(0x1192, forward(3).u32(29, 2));
    EXPECT_EQ(row("kFLDataRate"), "");
    receive(0x1192, forward(4).u32(29, 3));
    EXPECT_EQ(row("kFLDataRate"), "1.00 kbps");
    state.set(Label("FLDataSeqNum"), "4");
    receive(0x1192, forward(5).u32(29, 4));
    EXPECT_EQ(row("kFLDataRate"), "");
    EXPECT_EQ(kept("FLDataSeqNum"), 5);
}

TEST_F(LinkDataRates, LinksDoNotMix)
{
    receive(0x1192, forward(1));
    receive(0x127E, reverse(2).u32(18, 8));
    EXPECT_EQ(shown(), "kFLDataRate: \nkRLDataRate: \n");
    receive(0x1192, forward(2).u32(29, 1));
    EXPECT_EQ(shown(), "kFLDataRate: 1.00 kbps\nkRLDataRate: \n");
}

TEST_F(LinkDataRates, ShortPacketsChangeNothing)
{
    receive(0x1192, forward(1));
    receive(0x1192, forward(2).u32(29, 1).length(240));
    receive(0x127E, reverse(2).u32(18, 1).length(1749));
    EXPECT_THAT(log.take(),
                ElementsAre("<3>Log code 0x1192 is 240 bytes long but must be at least 241 bytes.",
                            "<3>Log code 0x127e is 1749 bytes long but must be at least 1750 bytes."));
    EXPECT_EQ(kept("FLDataSeqNum"), 1);
    EXPECT_EQ(kept("RLDataSeqNum"), -1);
    EXPECT_EQ(extraInfo(), "FLDataSeqNum1=1 FLDataSent1=0 ");
    receive(0x1192, forward(2).u32(29, 1).length(242));
    receive(0x127E, reverse(2).length(1751));
    EXPECT_EQ(row("kFLDataRate"), "1.00 kbps");
    EXPECT_EQ(kept("RLDataSeqNum"), 2);
    EXPECT_THAT(log.take(), IsEmpty());
}

} // namespace
} // namespace pelorus::test
