#include "LogGenerator/Osprey/LTE/NeighborMeasurementMisc.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

class NeighborMeasurementMiscTest : public testing::Test {
protected:
    SectionFixture<NeighborMeasurementMisc> section{makeDictionary()};
};

TEST_F(NeighborMeasurementMiscTest, SubscribesToTheIdleModeNeighbors)
{
    EXPECT_EQ(section.section.getSectionName(), "Neighbor Measurements");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xB180));
}

TEST_F(NeighborMeasurementMiscTest, ShowsEveryRowInTableOrder)
{
    section.receive(0xB180,
                    PacketBuilder(21).u8(13, 4).u16(17, 6300).bits(19, 0, 6, 8).bits(19, 6, 10, 1023));
    EXPECT_EQ(section.shown(), "Version: 4\n"
                               "E-ARFCN: 6300\n"
                               "Qrxlevmin: -124 dBm\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Neighbor Measurements"));
}

TEST_F(NeighborMeasurementMiscTest, ShowsBothEndsOfItsFields)
{
    section.receive(0xB180, PacketBuilder(21));
    EXPECT_EQ(section.shown(), "Version: 0\nE-ARFCN: 0\nQrxlevmin: -140 dBm\n");
    section.receive(0xB180, PacketBuilder(21).u8(13, 255).u16(17, 65535).u16(19, 65535));
    EXPECT_EQ(section.shown(), "Version: 255\nE-ARFCN: 65535\nQrxlevmin: -14 dBm\n");
}

TEST_F(NeighborMeasurementMiscTest, NeedsTwentyOneBytes)
{
    section.receive(0xB180, PacketBuilder(20).u8(13, 4));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Neighbor Measurements"));
    section.receive(0xB180, PacketBuilder(21).u8(13, 4));
    section.receive(0xB180, PacketBuilder(20).u8(13, 5));
    EXPECT_EQ(section.row("Version"), "4");
    section.receive(0xB180, PacketBuilder(22).u8(13, 6));
    EXPECT_EQ(section.row("Version"), "6");
}

TEST_F(NeighborMeasurementMiscTest, LogsAForeignCodeAndChangesNothing)
{
    section.receive(0xB181, PacketBuilder(21));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Neighbor Measurements", "<3>Received an unknown log message: 45441"));
}

} // namespace
} // namespace pelorus::test
