#include "LogGenerator/Osprey/LTE/ConnectedModeMeasurementMisc.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

PacketBuilder fullPacket()
{
    return PacketBuilder(29).u16(17, 1850).u16(19, 301).u16(21, 1023).u16(23, 190).u16(25, 75);
}

class ConnectedModeMeasurementMiscTest : public testing::Test {
protected:
    SectionFixture<ConnectedModeMeasurementMisc> section{makeDictionary()};
};

TEST_F(ConnectedModeMeasurementMiscTest, SubscribesToTheConnectedModeMeasurement)
{
    EXPECT_EQ(section.section.getSectionName(), "Connected mode LTE Intra-frequency Measurement");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xB179));
}

TEST_F(ConnectedModeMeasurementMiscTest, ShowsEveryRowInTableOrder)
{
    section.receive(0xB179, fullPacket());
    EXPECT_EQ(section.shown(),
              "E-ARFCN: 1850\n"
              "Serving Physical Cell ID: 301\n"
              "Subframe Number: 1023\n"
              "Serving Filtered RSRP: -92.50 dBm\n"
              "Serving Filtered RSRQ: -10.62 dB\n"); // -10.625, the tie goes to the even digit
    EXPECT_THAT(section.logged(), ElementsAre("<4>Connected mode LTE Intra-frequency Measurement"));
}

TEST_F(ConnectedModeMeasurementMiscTest, ShowsLevelsOfAllSixteenBits)
{
    section.receive(0xB179, PacketBuilder(29));
    EXPECT_EQ(section.row("Serving Filtered RSRP"), "-140.00 dBm");
    EXPECT_EQ(section.row("Serving Filtered RSRQ"), "-20.00 dB");
    section.receive(0xB179, PacketBuilder(29).u16(23, 560).u16(25, 160));
    EXPECT_EQ(section.row("Serving Filtered RSRP"), "0.00 dBm");
    EXPECT_EQ(section.row("Serving Filtered RSRQ"), "0.00 dB");
    section.receive(
        0xB179, PacketBuilder(29).u16(17, 65535).u16(19, 65535).u16(21, 65535).u16(23, 65535).u16(25, 65535));
    EXPECT_EQ(section.shown(), "E-ARFCN: 65535\n"
                               "Serving Physical Cell ID: 65535\n"
                               "Subframe Number: 65535\n"
                               "Serving Filtered RSRP: 16243.75 dBm\n"
                               "Serving Filtered RSRQ: 8171.88 dB\n"); // 8171.875
}

TEST_F(ConnectedModeMeasurementMiscTest, NeedsTwentyNineBytes)
{
    section.receive(0xB179, fullPacket().length(28));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Connected mode LTE Intra-frequency Measurement"));
    section.receive(0xB179, fullPacket().length(29));
    EXPECT_EQ(section.rowCount(), 5U);
    section.receive(0xB179, PacketBuilder(28).u16(17, 9));
    EXPECT_EQ(section.row("E-ARFCN"), "1850");
    section.receive(0xB179, PacketBuilder(30).u16(17, 9));
    EXPECT_EQ(section.row("E-ARFCN"), "9");
}

TEST_F(ConnectedModeMeasurementMiscTest, LogsAForeignCodeAndChangesNothing)
{
    section.receive(0xB17F, fullPacket());
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Connected mode LTE Intra-frequency Measurement",
                                              "<3>Received an unknown log message: 45439"));
}

} // namespace
} // namespace pelorus::test
