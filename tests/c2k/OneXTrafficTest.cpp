#include "tests/c2k/C2KFixture.h"
#include "tests/c2k/SubpacketBuilder.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class OneXTraffic : public C2KFixture {
protected:
    OneXTraffic() : C2KFixture({"k1xTrafficFER"}) {}

    void receiveFrame(unsigned error)
    {
        receive(0x119D, SubpacketBuilder().add(11, PacketBuilder(25).u8(24, error)).bytes());
    }
    std::string receiveFrames(unsigned error, int count)
    {
        for (int frame = 0; frame < count; ++frame)
            receiveFrame(error);
        return row("k1xTrafficFER");
    }
};

TEST_F(OneXTraffic, LostFramesRaiseTheRateByAFractionOfTheRest)
{
    EXPECT_EQ(receiveFrames(1, 1), "1.56%");
    EXPECT_EQ(receiveFrames(1, 1), "3.10%");
    EXPECT_EQ(receiveFrames(255, 1), "4.61%");
    EXPECT_EQ(receiveFrames(1, 1), "6.11%");
    EXPECT_EQ(receiveFrames(1, 1000), "100.00%");
    EXPECT_LE(*state.at("TrafficFER").real(), 1.0);
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(OneXTraffic, ReceivedFramesLowerIt)
{
    EXPECT_EQ(receiveFrames(0, 1), "0.00%");
    receiveFrames(1, 1);
    EXPECT_EQ(receiveFrames(0, 1), "1.54%"); // 1/64 * 63/64
    EXPECT_EQ(receiveFrames(0, 1), "1.51%");
}

TEST_F(OneXTraffic, TheRateHasSinglePrecision)
{
    receiveFrames(1, 4);
    EXPECT_EQ(*state.at("TrafficFER").real(), 0.061050355434417725);
    state.set(Label("TrafficFER"), 0.1); // a double that is no float
    receiveFrame(0);
    EXPECT_EQ(*state.at("TrafficFER").real(), double{0.1F * 0.984375F});
}

TEST_F(OneXTraffic, AnyNumberOfTheStateCounts)
{
    state.set(Label("TrafficFER"), 1);
    EXPECT_EQ(receiveFrames(1, 1), "100.00%");
    state.set(Label("TrafficFER"), "1");
    EXPECT_EQ(receiveFrames(1, 1), "1.56%");
}

TEST_F(OneXTraffic, StartsAfreshAfterTraffic)
{
    receiveFrames(1, 2);
    receive(0x119C, SubpacketBuilder()
                        .add(1, PacketBuilder(5).u8(4, 6))
                        .add(2, PacketBuilder(14))
                        .add(3, PacketBuilder(12))
                        .add(4, PacketBuilder(4))
                        .bytes());
    EXPECT_EQ(row("k1xTrafficFER"), "3.10% (old)");
    EXPECT_EQ(receiveFrames(1, 1), "1.56%");
}

TEST_F(OneXTraffic, IsMoreThan16BytesLongAndHasItsSubpacket)
{
    receive(0x119D, PacketBuilder(16));
    EXPECT_THAT(log.take(),
                ElementsAre("<3>Log code 0x119d is 16 bytes long but must be at least 17 bytes."));
    receive(0x119D, PacketBuilder(17));
    receive(0x119D, SubpacketBuilder().add(10, PacketBuilder(25)).bytes());
    EXPECT_THAT(log.take(), ElementsAre("<4>Log code 0x119d: missing traffic demod subpacket.",
                                        "<4>Log code 0x119d: missing traffic demod subpacket."));
    receive(0x119D, SubpacketBuilder().addSized(11, 42, PacketBuilder(25)).bytes());
    EXPECT_THAT(log.take(), ElementsAre("<3>Log code error in subpkt#0: bad size (42).",
                                        "<4>Log code 0x119d: missing traffic demod subpacket."));
    EXPECT_EQ(row("k1xTrafficFER"), "");
    EXPECT_FALSE(state.find("TrafficFER"));
}

TEST_F(OneXTraffic, AShortSubpacketHasNoFrameError)
{
    receive(0x119D, SubpacketBuilder().add(11, PacketBuilder(24)).add(1, PacketBuilder(8).u8(0, 1)).bytes());
    EXPECT_EQ(row("k1xTrafficFER"), "0.00%");
    receive(0x119D, SubpacketBuilder().addSized(11, 30, PacketBuilder(20)).bytes());
    EXPECT_EQ(row("k1xTrafficFER"), "0.00%");
}

} // namespace
} // namespace pelorus::test
