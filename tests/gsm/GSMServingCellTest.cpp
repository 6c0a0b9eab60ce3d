#include "LogGenerator/Osprey/GSM/GSMServingCell.h"
#include "tests/gsm/Packets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

TEST(GSMServingCell, ShowsIdentityMeasurementAndDedicatedChannel)
{
    SectionFixture<GSMServingCell> section(makeDictionary());
    section.receive(0x5134, gsmCell());
    section.receive(0x5137, gsmMeasurement());
    section.receive(0x5076, dedicatedChannel());
    EXPECT_EQ(section.shown(), "Cell ID: 43981\n"
                               "ARFCN: 871\n"
                               "BSIC: 43\n"
                               "RSSI: 190 dBm\n"           // the raw level, with no sign change: meant
                               "C1 Value: 32\n"            // of 0xFFFF0020 the low half
                               "C2 Value: 65534\n"         // of 0x0001FFFE likewise, unsigned
                               "MA Dedicated ARFCN: 3\n"); // of 0x0203 the low byte
    EXPECT_THAT(section.logged(), ElementsAre("<4>GSMServingCell", "<4>GSMServingCell", "<4>GSMServingCell"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x5134, 0x5137, 0x5076, 0xFF0001));
}

TEST(GSMServingCell, ShowsIdentitiesUnsigned)
{
    SectionFixture<GSMServingCell> section(makeDictionary());
    section.receive(0x5134, PacketBuilder(26).u16(13, 0xFFFF).u16(15, 0xFFFE).u16(17, 0xFFFD));
    EXPECT_EQ(section.shown(), "Cell ID: 65533\nARFCN: 65535\nBSIC: 65534\n");
}

TEST(GSMServingCell, OverwritesTheIdentityWithTheMonitoredOneAndBack)
{
    SectionFixture<GSMServingCell> section(makeDictionary());
    section.receive(0x5134, gsmCell());
    section.receive(0xFF0001, monitoredCells({umtsServingCell(), gsmNeighbor(), gsmServingCell()}));
    EXPECT_EQ(section.shown(), "Cell ID: 5678\nARFCN: 87\nBSIC: 43\n");
    section.receive(0x5134, gsmCell());
    EXPECT_EQ(section.shown(), "Cell ID: 43981\nARFCN: 871\nBSIC: 43\n");
}

TEST(GSMServingCell, TakesTheFirstOfTwoServingCells)
{
    SectionFixture<GSMServingCell> section(makeDictionary());
    section.receive(0xFF0001,
                    monitoredCells({gsmServingCell(), cell("GSM", "Serving", {{"CellMonitorCellId", 1}})}));
    EXPECT_EQ(section.shown(), "Cell ID: 5678\nARFCN: 87\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>GSMServingCell"));
}

TEST(GSMServingCell, LogsEachMissingNumberAndTriesTheNext)
{
    SectionFixture<GSMServingCell> section(makeDictionary());
    section.receive(0xFF0001, monitoredCells({cell("GSM", "Serving", {{"CellMonitorARFCN", 88}})}));
    EXPECT_EQ(section.shown(), "ARFCN: 88\n");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>GSMServingCell", "<3>GSMServingCell: Failed to retrieve Cell ID\n"));
    section.receive(0xFF0001,
                    monitoredCells({cell("GSM", "Serving",
                                         {{"CellMonitorCellId", 0x1FFFFFFFF}, {"CellMonitorARFCN", 8.5}})}));
    EXPECT_EQ(section.shown(), "ARFCN: 88\nCell ID: -1\n"); // of a wider number the low 32 bits
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>GSMServingCell", "<3>GSMServingCell: Failed to retrieve ARFCN\n"));
}

} // namespace
} // namespace pelorus::test
