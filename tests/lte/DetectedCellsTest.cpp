#include "LogGenerator/Osprey/LTE/DetectedCells.h"
#include "tests/support/HostilePackets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

class DetectedCellsTest : public testing::Test {
protected:
    SectionFixture<DetectedCells> section{makeArray()};
};

TEST_F(DetectedCellsTest, SubscribesToTheConnectedModeMeasurement)
{
    EXPECT_EQ(section.section.getSectionName(), "Detected Cells");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xB179));
}

TEST_F(DetectedCellsTest, StandBehindTheMeasuredCells)
{
    section.receive(0xB179, PacketBuilder(43).u8(27, 2).u8(28, 1).u16(29, 1).u16(39, 2).u16(41, 417));
    EXPECT_EQ(section.shown(), "-\n  Physical Cell ID: 417\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Detected Cells"));
}

TEST_F(DetectedCellsTest, BeginAtTheFirstRecordWhenNothingWasMeasured)
{
    section.receive(0xB179, PacketBuilder(33).u8(28, 2).u16(29, 65535).u16(31, 9));
    EXPECT_EQ(section.shown(), "-\n  Physical Cell ID: 65535\n-\n  Physical Cell ID: 9\n");
}

TEST_F(DetectedCellsTest, AreReplacedWholeWithEveryPacket)
{
    section.receive(0xB179, PacketBuilder(33).u8(28, 2).u16(29, 8).u16(31, 9));
    section.receive(0xB179, PacketBuilder(31).u8(28, 1).u16(29, 7));
    EXPECT_EQ(section.shown(), "-\n  Physical Cell ID: 7\n");
    section.receive(0xB179, PacketBuilder(35).u8(27, 1));
    EXPECT_EQ(section.shown(), "");
}

TEST_F(DetectedCellsTest, StayWhenThePacketIsOneByteShort)
{
    section.receive(0xB179, PacketBuilder(31).u8(28, 1).u16(29, 7));
    section.receive(0xB179, PacketBuilder(28));
    EXPECT_EQ(section.shown(), "-\n  Physical Cell ID: 7\n");
}

TEST_F(DetectedCellsTest, LogAForeignCode)
{
    section.receive(0xB179, PacketBuilder(31).u8(28, 1).u16(29, 7));
    section.logged();
    section.receive(0xB186, PacketBuilder(29));
    EXPECT_EQ(section.shown(), "-\n  Physical Cell ID: 7\n");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Detected Cells", "<3>Received an unknown log message: 45446"));
}

TEST_F(DetectedCellsTest, EndWithThePacket)
{
    // With 2 measured cells the detected ones begin at 41.
    forEachPrefix(PacketBuilder(41 + 9).u8(27, 2).u8(28, 255).bytes(), [this](const LogPacket& packet) {
        section.section.updateWithData(packet, 0xB179);
        const std::size_t whole = packet.size() < 41 ? 0 : (packet.size() - 41) / 2;
        EXPECT_EQ(section.rowCount(), whole) << packet.size();
    });
    section.receive(0xB179, PacketBuilder(60).u8(27, 255).u8(28, 255));
    EXPECT_EQ(section.shown(), "");
}

} // namespace
} // namespace pelorus::test
