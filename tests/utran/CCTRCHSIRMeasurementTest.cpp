#include "LogGenerator/Osprey/UTRAN/CCTRCHSIRMeasurement.h"

#include "tests/support/HostilePackets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

/// A packet with T transport channels and C composite ones, all bytes 0.
PacketBuilder channels(unsigned transport, unsigned composite)
{
    return PacketBuilder(289 + 34 * transport + 8 * composite).u16(14, transport << 6 | composite << 12);
}

class CCTRCHSIRMeasurementTest : public testing::Test {
protected:
    SectionFixture<CCTRCHSIRMeasurement> section{makeArray()};
};

TEST_F(CCTRCHSIRMeasurementTest, SubscribesToTheTransportChannels)
{
    EXPECT_EQ(section.section.getSectionName(), "CCTRCH SIR");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xD00C));
}

TEST_F(CCTRCHSIRMeasurementTest, ShowsTheValuesOfEachChannelAsAListInByteOrder)
{
    section.receive(0xD00C, channels(0, 2)
                                .u8(289, 1)
                                .u8(290, 2)
                                .u8(291, 10)
                                .u8(292, 11)
                                .u8(293, 12)
                                .u8(294, 13)
                                .u8(295, 14)
                                .u8(296, 255)
                                .u8(297, 3));
    EXPECT_EQ(section.shown(), "-\n"
                               "  CCTRCH ID: 1\n"
                               "  TSNUM: 2\n"
                               "  SIR:\n"
                               "    - 10\n"
                               "    - 11\n"
                               "    - 12\n"
                               "    - 13\n"
                               "    - 14\n"
                               "    - 255\n"
                               "-\n"
                               "  CCTRCH ID: 3\n"
                               "  TSNUM: 0\n"
                               "  SIR:\n"
                               "    - 0\n"
                               "    - 0\n"
                               "    - 0\n"
                               "    - 0\n"
                               "    - 0\n"
                               "    - 0\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>CCTRCH SIR Measurement"));
}

TEST_F(CCTRCHSIRMeasurementTest, BeginsThirtyFourBytesFurtherForEachTransportChannel)
{
    section.receive(0xD00C, channels(2, 1).u8(357, 9).u8(358, 8).u8(359, 7).u8(364, 6));
    EXPECT_EQ(section.shown(), "-\n"
                               "  CCTRCH ID: 9\n"
                               "  TSNUM: 8\n"
                               "  SIR:\n"
                               "    - 7\n"
                               "    - 0\n"
                               "    - 0\n"
                               "    - 0\n"
                               "    - 0\n"
                               "    - 6\n");
}

TEST_F(CCTRCHSIRMeasurementTest, CountsWithFourBits)
{
    section.receive(0xD00C, channels(63, 15).u16(14, 0xFFFF));
    EXPECT_EQ(section.rowCount(), 15U);
    section.receive(0xD00C, PacketBuilder(17).u16(14, 0x0FFF));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST_F(CCTRCHSIRMeasurementTest, KeepsNothingFromOnePacketToTheNext)
{
    section.receive(0xD00C, channels(0, 2).u8(289, 1).u32(291, 0xFFFFFFFF).u8(297, 2).u32(299, 0xFFFFFFFF));
    section.receive(0xD00C, channels(0, 1).u8(291, 1));
    EXPECT_EQ(section.shown(), "-\n"
                               "  CCTRCH ID: 0\n"
                               "  TSNUM: 0\n"
                               "  SIR:\n"
                               "    - 1\n"
                               "    - 0\n"
                               "    - 0\n"
                               "    - 0\n"
                               "    - 0\n"
                               "    - 0\n");
    section.receive(0xD00C, channels(0, 2).u8(289, 1).u8(297, 2));
    EXPECT_EQ(section.rowCount(), 2U);
    EXPECT_NE(section.entry.array()->elements[0].dictionary()->at("SIR").array(),
              section.entry.array()->elements[1].dictionary()->at("SIR").array());
}

TEST_F(CCTRCHSIRMeasurementTest, LeavesACopyOfTheListAsItWas)
{
    section.receive(0xD00C, channels(0, 1).u8(291, 77));
    const Value copy = deepCopy(section.entry);
    const std::string before = textOf(copy);
    section.receive(0xD00C, channels(0, 1).u8(291, 78));
    EXPECT_EQ(textOf(copy), before);
    EXPECT_NE(section.shown(), before);
}

TEST_F(CCTRCHSIRMeasurementTest, KeepsTheListWhenThePacketIsOneByteShort)
{
    section.receive(0xD00C, channels(0, 2));
    section.logged();
    section.receive(0xD00C, PacketBuilder(16));
    EXPECT_EQ(section.rowCount(), 2U);
    EXPECT_THAT(section.logged(), ElementsAre("<4>CCTRCH SIR Measurement"));
}

TEST_F(CCTRCHSIRMeasurementTest, IgnoresOtherCodes)
{
    section.receive(0xD00C, channels(0, 2));
    section.logged();
    section.receive(0xD00A, channels(0, 1));
    EXPECT_EQ(section.rowCount(), 2U);
    EXPECT_THAT(section.logged(), ElementsAre("<4>CCTRCH SIR Measurement"));
}

TEST_F(CCTRCHSIRMeasurementTest, RaisesForEveryPrefixThatIsLongEnoughForTheCountOnly)
{
    section.receive(0xD00C, channels(0, 1));
    forEachPrefix(channels(1, 2).bytes(), [this](const LogPacket& packet) {
        if (packet.size() >= 17 && packet.size() < 339)
            EXPECT_THROW(section.section.updateWithData(packet, 0xD00C), ArrayOutOfBoundsException)
                << packet.size();
        else
            EXPECT_NO_THROW(section.section.updateWithData(packet, 0xD00C)) << packet.size();
        EXPECT_EQ(section.rowCount(), packet.size() < 17    ? 1U
                                      : packet.size() < 339 ? 0U
                                                            : 2U)
            << packet.size();
    });
}

} // namespace
} // namespace pelorus::test
