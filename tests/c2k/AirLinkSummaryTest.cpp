#include "tests/c2k/C2KFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class AirLinkSummary : public C2KFixture {
protected:
    AirLinkSummary()
        : C2KFixture({"kChannel", "k1xEVDODeviceState", "kBandClass", "kRxAGC0", "kRxAGC1", "kTxAGC",
                      "kServingPNOffset", "kSessionState", "kUATI24", "kColorCode"})
    {}
    static PacketBuilder packet()
    {
        return PacketBuilder(50)
            .u8(13, 0x19)
            .u8(14, 0x0A) // band class 1, channel 2 * 256
            .s8(15, -71)
            .s8(16, -80)
            .s8(17, 4)
            .u16(18, 132)
            .u8(36, 5)
            .u8(37, 4)
            .u16(38, 0xBEEF)
            .u8(40, 0x01)
            .u8(41, 42);
    }
};

TEST_F(AirLinkSummary, ShowsEveryRow)
{
    receive(0x1183, packet());
    EXPECT_EQ(shown(), "kChannel: 537\n"
                       "k1xEVDODeviceState: Connected [5]\n"
                       "kBandClass: 1.8 to 2.0GHz PCS band [1]\n"
                       "kRxAGC0: -71 dBm\n"
                       "kRxAGC1: -80 dBm\n"
                       "kTxAGC: +4 dBm\n"
                       "kServingPNOffset: 132 × 64chips\n"
                       "kSessionState: Open [4]\n"
                       "kUATI24: 0x01beef\n"
                       "kColorCode: 42\n");
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(AirLinkSummary, TakesNoOtherLengthThan50)
{
    receive(0x1183, packet());
    const std::string before = shown();
    log.take();
    receive(0x1183, packet().u8(41, 7).length(49));
    receive(0x1183, packet().u8(41, 7).length(51));
    EXPECT_EQ(shown(), before);
    EXPECT_THAT(log.take(), ElementsAre("<3>Log code 0x1183 is 49 bytes long but should be 50 bytes.",
                                        "<3>Log code 0x1183 is 51 bytes long but should be 50 bytes."));
    receive(0x1183, packet().u8(41, 7));
    EXPECT_EQ(row("kColorCode"), "7");
}

TEST_F(AirLinkSummary, ShowsSecondChainAndTransmitterFromAccessOn)
{
    const char* const texts[] = {"Inactive [0]", "Acquisition [1]", "Sync [2]",     "Idle [3]",
                                 "Access [4]",   "Connected [5]",   "[Reserved 6]", "[Reserved 7]"};
    for (unsigned state = 0; state < std::size(texts); ++state) {
        receive(0x1183, packet().u8(36, state));
        EXPECT_EQ(row("k1xEVDODeviceState"), texts[state]);
        EXPECT_EQ(row("kRxAGC1"), state < 4 ? "N/A" : "-80 dBm") << state;
        EXPECT_EQ(row("kTxAGC"), state < 4 ? "N/A" : "+4 dBm") << state;
        EXPECT_EQ(row("kRxAGC0"), "-71 dBm") << state;
    }
    receive(0x1183, packet().u8(36, 255));
    EXPECT_EQ(row("k1xEVDODeviceState"), "[Reserved 255]");
    receive(0x1183, packet().u8(36, 3));
    EXPECT_EQ(row("kTxAGC"), "N/A");
    receive(0x1183, packet().u8(36, 4));
    EXPECT_EQ(row("kTxAGC"), "+4 dBm"); // the same level again, after the text between
}

TEST_F(AirLinkSummary, NamesEverySessionState)
{
    const char* const texts[] = {"Closed [0]",        "AMP setup [1]", "AT-initiated neg [2]",
                                 "Initiated neg [3]", "Open [4]",      "[Reserved 5]"};
    for (unsigned state = 0; state < std::size(texts); ++state) {
        receive(0x1183, packet().u8(37, state));
        EXPECT_EQ(row("kSessionState"), texts[state]);
    }
    receive(0x1183, packet().u8(37, 255));
    EXPECT_EQ(row("kSessionState"), "[Reserved 255]");
}

TEST_F(AirLinkSummary, NamesEveryBandClass)
{
    const char* const texts[] = {"800 MHz cellular band [0]",
                                 "1.8 to 2.0GHz PCS band [1]",
                                 "872 to 960MHz TACS band [2]",
                                 "832 to 925MHz JTACS band [3]",
                                 "1.75 to 1.87GHz Korean PCS band [4]",
                                 "450MHz band [5]",
                                 "2GHz band [6]",
                                 "700MHz band [7]",
                                 "1800 MHz band [8]",
                                 "900 MHzband [9]",
                                 "Secondary 800 MHz band [10]",
                                 "400 MHz European PAMR band [11]",
                                 "800 MHz European PAMR band [12]",
                                 "[Bad Value 13]"};
    for (unsigned band = 0; band < std::size(texts); ++band) {
        receive(0x1183, packet().u8(14, band << 3));
        EXPECT_EQ(row("kBandClass"), texts[band]);
        EXPECT_EQ(row("kChannel"), "25");
    }
    receive(0x1183, packet().u8(14, 0xF8));
    EXPECT_EQ(row("kBandClass"), "[Bad Value 31]");
}

TEST_F(AirLinkSummary, ChannelHasElevenBits)
{
    receive(0x1183, packet().u16(13, 0x07FF));
    EXPECT_EQ(row("kChannel"), "2047");
    receive(0x1183, packet().u16(13, 0xF800));
    EXPECT_EQ(row("kChannel"), "0");
}

TEST_F(AirLinkSummary, LevelsHaveASign)
{
    receive(0x1183, packet().s8(15, -128).s8(16, 127).s8(17, 0));
    EXPECT_EQ(row("kRxAGC0"), "-128 dBm");
    EXPECT_EQ(row("kRxAGC1"), "+127 dBm");
    EXPECT_EQ(row("kTxAGC"), "+0 dBm");
}

TEST_F(AirLinkSummary, OnlyOneServingPilotIsInvalid)
{
    receive(0x1183, packet().u16(18, 0xFFFF));
    EXPECT_EQ(row("kServingPNOffset"), "Invalid Value");
    receive(0x1183, packet().u16(18, 0xFFFE));
    EXPECT_EQ(row("kServingPNOffset"), "65534 × 64chips");
    receive(0x1183, packet().u16(18, 0));
    EXPECT_EQ(row("kServingPNOffset"), "0 × 64chips");
}

TEST_F(AirLinkSummary, AccessTerminalHasSixHexadecimalDigits)
{
    receive(0x1183, packet().u16(38, 0xFFFF).u8(40, 0xFF).u8(41, 0xFF));
    EXPECT_EQ(row("kUATI24"), "0xffffff");
    EXPECT_EQ(row("kColorCode"), "255");
    receive(0x1183, packet().u16(38, 0x000A).u8(40, 0));
    EXPECT_EQ(row("kUATI24"), "0x00000a");
}

} // namespace
} // namespace pelorus::test
