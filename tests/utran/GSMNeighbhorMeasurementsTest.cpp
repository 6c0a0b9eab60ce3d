#include "LogGenerator/Osprey/UTRAN/GSMNeighbhorMeasurements.h"

#include "LogGenerator/Osprey/UTRAN/LogCode_0xD00E.h"
#include "tests/support/HostilePackets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

PacketBuilder gsmCells(unsigned count)
{
    return PacketBuilder(17 + 8 * count).u8(16, count);
}

class GSMNeighbhorMeasurementsTest : public testing::Test {
protected:
    SectionFixture<GSMNeighbhorMeasurements> section{makeArray({"left over"})};
};

TEST_F(GSMNeighbhorMeasurementsTest, SubscribesToTheGSMNeighbors)
{
    EXPECT_EQ(section.section.getSectionName(), "GSM Neighbor Cell List");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xD00E));
}

TEST_F(GSMNeighbhorMeasurementsTest, LeavesItsListEmptyWhateverItRead)
{
    section.receive(0xD00E, gsmCells(5));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>GSM Neighbor Cell List"));
    section.receive(0xD00E, gsmCells(255));
    EXPECT_EQ(section.shown(), "");
}

TEST_F(GSMNeighbhorMeasurementsTest, EmptiesTheListWhenThereAreNoCells)
{
    section.receive(0xD00E, PacketBuilder(17));
    EXPECT_EQ(section.shown(), "");
}

TEST_F(GSMNeighbhorMeasurementsTest, KeepsTheListWhenThePacketIsOneByteShort)
{
    section.receive(0xD00E, PacketBuilder(16));
    EXPECT_EQ(section.shown(), "- left over\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>GSM Neighbor Cell List"));
}

TEST_F(GSMNeighbhorMeasurementsTest, IgnoresOtherCodes)
{
    section.receive(0xD00A, gsmCells(5));
    EXPECT_EQ(section.shown(), "- left over\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>GSM Neighbor Cell List"));
}

TEST_F(GSMNeighbhorMeasurementsTest, RaisesWhenThePacketEndsBeforeItsCellsAndLeavesTheListEmpty)
{
    EXPECT_THROW(section.receive(0xD00E, gsmCells(5).length(56)), ArrayOutOfBoundsException);
    EXPECT_EQ(section.shown(), "");
}

TEST_F(GSMNeighbhorMeasurementsTest, RaisesForEveryPrefixThatIsLongEnoughForTheCountOnly)
{
    forEachPrefix(gsmCells(2).bytes(), [this](const LogPacket& packet) {
        if (packet.size() >= 17 && packet.size() < 33)
            EXPECT_THROW(section.section.updateWithData(packet, 0xD00E), ArrayOutOfBoundsException)
                << packet.size();
        else
            EXPECT_NO_THROW(section.section.updateWithData(packet, 0xD00E)) << packet.size();
    });
}

// The rows are never shown, so that the layout can only be looked at itself.
TEST(GSMNeighborLayout, PlacesTheFieldsOfACell)
{
    using Cell = LogCode_0xD00E::Cell;
    const PacketBuilder bytes =
        PacketBuilder(8).u8(0, 0x34).u8(1, 0x52).u8(2, 7).u8(3, 6).u16(4, 975).s16(6, -91);
    const PacketView cell(bytes.bytes());
    EXPECT_EQ(cell[Cell::cellIdentity], 0x1234);
    EXPECT_EQ(cell[Cell::bandIndicator], 1);
    EXPECT_EQ(cell[Cell::bsicValid], 0);
    EXPECT_EQ(cell[Cell::networkColourCode], 7);
    EXPECT_EQ(cell[Cell::stationColourCode], 6);
    EXPECT_EQ(cell[Cell::arfcn], 975);
    EXPECT_EQ(cell[Cell::rssi], -91);
    const PacketBuilder flags = PacketBuilder(8).u8(1, 0x80);
    EXPECT_EQ(PacketView(flags.bytes())[Cell::bsicValid], 1);
    EXPECT_EQ(PacketView(flags.bytes())[Cell::bandIndicator], 0);
    EXPECT_EQ(PacketView(flags.bytes())[Cell::cellIdentity], 0);
}

} // namespace
} // namespace pelorus::test
