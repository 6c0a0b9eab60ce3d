#include "LogGenerator/Osprey/UTRAN/TRCHBLERMeasurement.h"

#include "tests/support/HostilePackets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

PacketBuilder channels(unsigned count)
{
    return PacketBuilder(17 + 2 * count).u16(14, count << 6);
}

class TRCHBLERMeasurementTest : public testing::Test {
protected:
    SectionFixture<TRCHBLERMeasurement> section{makeArray()};
};

TEST_F(TRCHBLERMeasurementTest, SubscribesToTheTransportChannels)
{
    EXPECT_EQ(section.section.getSectionName(), "TRCH BLER");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xD00C));
}

TEST_F(TRCHBLERMeasurementTest, ShowsTheRawRateOfEachChannelAndLogsANotice)
{
    section.receive(0xD00C, channels(2).u8(16, 255).u8(17, 1).u8(18, 63).u8(19, 255).u8(20, 0));
    EXPECT_EQ(section.shown(), "-\n"
                               "  TRCH ID: 1\n"
                               "  TRCH BLER Measurement: 63\n"
                               "-\n"
                               "  TRCH ID: 255\n"
                               "  TRCH BLER Measurement: 0\n");
    EXPECT_THAT(section.logged(), ElementsAre("<5>TRCH BLER Measurement"));
}

TEST_F(TRCHBLERMeasurementTest, CountsWithSixBits)
{
    section.receive(0xD00C, PacketBuilder(17 + 126).u16(14, 0xFFFF));
    EXPECT_EQ(section.rowCount(), 63U);
    section.receive(0xD00C, PacketBuilder(17).u16(14, 0xF03F));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST_F(TRCHBLERMeasurementTest, KeepsTheListWhenThePacketIsOneByteShort)
{
    section.receive(0xD00C, channels(2));
    section.logged();
    section.receive(0xD00C, PacketBuilder(16));
    EXPECT_EQ(section.rowCount(), 2U);
    EXPECT_THAT(section.logged(), ElementsAre("<5>TRCH BLER Measurement"));
}

TEST_F(TRCHBLERMeasurementTest, IgnoresOtherCodes)
{
    section.receive(0xD00C, channels(2));
    section.logged();
    section.receive(0xD00A, channels(1));
    EXPECT_EQ(section.rowCount(), 2U);
    EXPECT_THAT(section.logged(), ElementsAre("<5>TRCH BLER Measurement"));
}

TEST_F(TRCHBLERMeasurementTest, RaisesForEveryPrefixThatIsLongEnoughForTheCountOnly)
{
    section.receive(0xD00C, channels(2));
    forEachPrefix(channels(3).bytes(), [this](const LogPacket& packet) {
        if (packet.size() >= 17 && packet.size() < 23)
            EXPECT_THROW(section.section.updateWithData(packet, 0xD00C), ArrayOutOfBoundsException)
                << packet.size();
        else
            EXPECT_NO_THROW(section.section.updateWithData(packet, 0xD00C)) << packet.size();
        EXPECT_EQ(section.rowCount(), packet.size() < 17   ? 2U
                                      : packet.size() < 23 ? 0U
                                                           : 3U)
            << packet.size();
    });
}

} // namespace
} // namespace pelorus::test
