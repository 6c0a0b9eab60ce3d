#include "tests/c2k/C2KFixture.h"
#include "tests/c2k/SubpacketBuilder.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class OneXState : public C2KFixture {
protected:
    OneXState()
        : C2KFixture({"k1xDeviceState", "k1xRx0BandClass", "k1xRx0ChanNum", "k1xRxAGC0", "k1xRx1BandClass",
                      "k1xRx1ChanNum", "k1xRxAGC1", "k1xTxAGC", "k1xActiveSetInfo", "k1xTrafficFER"})
    {}

    PacketBuilder system = PacketBuilder(5).u8(4, 8);
    PacketBuilder radio =
        PacketBuilder(14).u8(4, 0).u8(5, 1).u16(6, 384).u16(8, 65535).s8(10, -128).s8(11, 127).s16(12, -215);
    PacketBuilder activeSet = PacketBuilder(12);
    PacketBuilder fingers = PacketBuilder(4);

    void receiveAll()
    {
        receive(0x119C,
                SubpacketBuilder().add(1, system).add(2, radio).add(3, activeSet).add(4, fingers).bytes());
    }
    void receiveState(unsigned number)
    {
        system.u8(4, number);
        receiveAll();
    }
    void receiveRate(double rate) { state.set(Label("TrafficFER"), rate); }
};

TEST_F(OneXState, ShowsEveryRowInTraffic)
{
    receiveAll();
    EXPECT_EQ(shown(), "k1xDeviceState: Traffic [8]\n"
                       "k1xRx0BandClass: 800 MHz cellular band [0]\n"
                       "k1xRx0ChanNum: 384\n"
                       "k1xRxAGC0: -106.00 dBm\n"
                       "k1xRx1BandClass: 1.8 to 2.0GHz PCS band [1]\n"
                       "k1xRx1ChanNum: 65535\n"
                       "k1xRxAGC1: -20.83 dBm\n"
                       "k1xTxAGC: -21.50 dBm\n"
                       "k1xActiveSetInfo:\n"
                       "  _sorted: _sorted\n"
                       "k1xTrafficFER: \n");
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(OneXState, ShowsSecondChainAndTransmitterInTrafficOnly)
{
    const char* const texts[] = {"Inactive [0]",
                                 "Deep sleep in start state [1]",
                                 "Initial state for CDMA operation [2]",
                                 "Acquisition [3]",
                                 "Sync [4]",
                                 "Slew [5]",
                                 "Paging [6]",
                                 "Slotted mode sleep state [7]",
                                 "Traffic [8]",
                                 "UnSlew [9]",
                                 "Operation in PCG state [10]",
                                 "Powerup state [11]",
                                 "[Bad Value 12]"};
    for (unsigned number = 0; number < std::size(texts); ++number) {
        receiveState(number);
        EXPECT_EQ(row("k1xDeviceState"), texts[number]);
        EXPECT_EQ(row("k1xRxAGC0"), "-106.00 dBm");
        EXPECT_EQ(row("k1xRx1BandClass"), number == 8 ? "1.8 to 2.0GHz PCS band [1]" : "N/A") << number;
        EXPECT_EQ(row("k1xRx1ChanNum"), number == 8 ? "65535" : "N/A") << number;
        EXPECT_EQ(row("k1xRxAGC1"), number == 8 ? "-20.83 dBm" : "N/A") << number;
        EXPECT_EQ(row("k1xTxAGC"), number == 8 ? "-21.50 dBm" : "N/A") << number;
    }
    receiveState(255);
    EXPECT_EQ(row("k1xDeviceState"), "[Bad Value 255]");
}

TEST_F(OneXState, NamesTheBandClassesOfBothChains)
{
    radio.u8(4, 9).u8(5, 12);
    receiveAll();
    EXPECT_EQ(row("k1xRx0BandClass"), "900 MHzband [9]");
    EXPECT_EQ(row("k1xRx1BandClass"), "800 MHz European PAMR band [12]");
    radio.u8(4, 13).u8(5, 255);
    receiveAll();
    EXPECT_EQ(row("k1xRx0BandClass"), "[Bad Value 13]");
    EXPECT_EQ(row("k1xRx1BandClass"), "[Bad Value 255]");
}

TEST_F(OneXState, LevelsHaveTwoDecimalsAndASign)
{
    radio.s8(10, 0).s8(11, 1).s16(12, 230);
    receiveAll();
    EXPECT_EQ(row("k1xRxAGC0"), "-63.25 dBm");
    EXPECT_EQ(row("k1xRxAGC1"), "-62.91 dBm");
    EXPECT_EQ(row("k1xTxAGC"), "+23.00 dBm");
    radio.s8(10, -1).s8(11, 100).s16(12, -32768);
    receiveAll();
    EXPECT_EQ(row("k1xRxAGC0"), "-63.58 dBm");
    EXPECT_EQ(row("k1xRxAGC1"), "-29.85 dBm");
    EXPECT_EQ(row("k1xTxAGC"), "-3276.80 dBm");
}

TEST_F(OneXState, IsMoreThan16BytesLong)
{
    receive(0x119C, PacketBuilder(16));
    EXPECT_THAT(log.take(),
                ElementsAre("<3>Log code 0x119c is 16 bytes long but must be at least 17 bytes."));
    receive(0x119C, PacketBuilder(17));
    receive(0x119C, PacketBuilder(18));
    EXPECT_THAT(log.take(), ElementsAre("<4>Log code 0x119c: missing subpacket (ss=0,rf=0,ai=0,fi=0).",
                                        "<4>Log code 0x119c: missing subpacket (ss=0,rf=0,ai=0,fi=0)."));
    EXPECT_EQ(row("k1xDeviceState"), "");
}

TEST_F(OneXState, NeedsAllFourSubpackets)
{
    state.set(Label("TrafficFER"), 0.5);
    system.u8(4, 3);
    receive(0x119C, SubpacketBuilder().add(2, radio).add(3, activeSet).add(4, fingers).bytes());
    receive(0x119C, SubpacketBuilder().add(1, system).add(3, activeSet).add(4, fingers).bytes());
    receive(0x119C, SubpacketBuilder().add(1, system).add(2, radio).add(4, fingers).bytes());
    receive(0x119C, SubpacketBuilder().add(1, system).add(2, radio).add(3, activeSet).bytes());
    EXPECT_THAT(log.take(), ElementsAre("<4>Log code 0x119c: missing subpacket (ss=0,rf=1,ai=1,fi=1).",
                                        "<4>Log code 0x119c: missing subpacket (ss=1,rf=0,ai=1,fi=1).",
                                        "<4>Log code 0x119c: missing subpacket (ss=1,rf=1,ai=0,fi=1).",
                                        "<4>Log code 0x119c: missing subpacket (ss=1,rf=1,ai=1,fi=0)."));
    EXPECT_EQ(row("k1xDeviceState"), "");
    EXPECT_EQ(row("k1xTrafficFER"), "");
    EXPECT_TRUE(state.find("TrafficFER"));
}

TEST_F(OneXState, EachSearchLogsTheBadSizeThatEndsIt)
{
    receive(0x119C, SubpacketBuilder().add(1, system).addSized(2, 9999, radio).add(3, activeSet).bytes());
    EXPECT_THAT(log.take(), ElementsAre("<3>Log code error in subpkt#1: bad size (9999).",
                                        "<3>Log code error in subpkt#1: bad size (9999).",
                                        "<3>Log code error in subpkt#1: bad size (9999).",
                                        "<4>Log code 0x119c: missing subpacket (ss=1,rf=0,ai=0,fi=0)."));
}

TEST_F(OneXState, TakesTheSubpacketsInAnyOrder)
{
    receive(0x119C, SubpacketBuilder()
                        .add(4, fingers)
                        .add(200, PacketBuilder(30))
                        .add(3, activeSet)
                        .add(2, radio)
                        .add(1, system)
                        .bytes());
    EXPECT_EQ(row("k1xDeviceState"), "Traffic [8]");
    EXPECT_EQ(row("k1xRx0ChanNum"), "384");
}

TEST_F(OneXState, FieldsBehindTheEndOfASubpacketAreZero)
{
    system.length(4);
    radio.length(10);
    activeSet.length(4);
    receiveAll(); // though the next subpacket's bytes follow
    EXPECT_EQ(row("k1xDeviceState"), "Inactive [0]");
    EXPECT_EQ(row("k1xRx0ChanNum"), "384");
    EXPECT_EQ(row("k1xRxAGC0"), "-63.25 dBm");
    EXPECT_EQ(row("k1xActiveSetInfo"), "_sorted: _sorted\n");
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(OneXState, OutsideOfTrafficTheErrorRateIsOld)
{
    receiveRate(0.5);
    receiveState(8);
    EXPECT_EQ(row("k1xTrafficFER"), "");
    EXPECT_TRUE(state.find("TrafficFER"));
    receiveState(6);
    EXPECT_EQ(row("k1xTrafficFER"), "50.00% (old)");
    EXPECT_FALSE(state.find("TrafficFER"));
    receiveState(7);
    EXPECT_EQ(row("k1xTrafficFER"), "50.00% (old)");
    state.set(Label("TrafficFER"), "no number");
    receiveState(7);
    EXPECT_EQ(row("k1xTrafficFER"), "50.00% (old)");
}

} // namespace
} // namespace pelorus::test
