#include "LogGenerator/Osprey/LTE/ReselectionCandidatesList.h"
#include "tests/support/HostilePackets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

// One candidate; its technology's fields reach beyond its 4 bytes.
PacketBuilder candidate(unsigned technology)
{
    return PacketBuilder(33).u16(19, 1).u16(21, 5).u16(23, technology);
}

class ReselectionCandidatesListTest : public testing::Test {
protected:
    SectionFixture<ReselectionCandidatesList> section{makeArray()};
};

TEST_F(ReselectionCandidatesListTest, SubscribesToTheReselectionCandidates)
{
    EXPECT_EQ(section.section.getSectionName(), "Reselection Candidates List");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xB186));
}

TEST_F(ReselectionCandidatesListTest, ShowsAnLTECandidate)
{
    section.receive(0xB186, candidate(0).u16(25, 6300).u8(27, 0x80).u8(28, 0x01));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Candidate Priority: 5\n"
                               "  Candidate RAT Type: LTE\n"
                               "  E ARFCN: 6300\n"
                               "  Cell ID: 3\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Reselection Candidates List"));
}

TEST_F(ReselectionCandidatesListTest, TakesTheNineHighBitsForAnLTECell)
{
    section.receive(0xB186, candidate(0).u16(25, 65535).u16(27, 65535));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Candidate Priority: 5\n"
                               "  Candidate RAT Type: LTE\n"
                               "  E ARFCN: 65535\n"
                               "  Cell ID: 511\n");
    section.receive(0xB186, candidate(0).u16(27, 0x7F));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Candidate Priority: 5\n"
                               "  Candidate RAT Type: LTE\n"
                               "  E ARFCN: 0\n"
                               "  Cell ID: 0\n");
}

TEST_F(ReselectionCandidatesListTest, ShowsAUTRANCandidate)
{
    section.receive(0xB186, candidate(1).u16(21, 65535).u16(25, 10713).u16(27, 500));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Candidate Priority: 65535\n"
                               "  Candidate RAT Type: UTRAN\n"
                               "  U ARFCN: 10713\n"
                               "  PSC: 500\n");
}

TEST_F(ReselectionCandidatesListTest, ShowsAGERANCandidate)
{
    section.receive(0xB186, candidate(2).u16(25, 975).u8(27, 255).u8(28, 63));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Candidate Priority: 5\n"
                               "  Candidate RAT Type: GERAN\n"
                               "  ARFCN: 975\n"
                               "  Band: 255\n"
                               "  BSIC ID: 63\n");
}

TEST_F(ReselectionCandidatesListTest, ShowsBothKindsOfCDMACandidate)
{
    section.receive(0xB186, candidate(3).u8(25, 10).u8(26, 255).u16(29, 476).u16(31, 168));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Candidate Priority: 5\n"
                               "  Candidate RAT Type: CDMA1XRTT\n"
                               "  Band: 10\n"
                               "  Channel: 476\n"
                               "  Pilot: 168\n");
    section.receive(0xB186, candidate(4).u8(25, 1).u16(29, 65535).u16(31, 65535));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Candidate Priority: 5\n"
                               "  Candidate RAT Type: CDMAHRPD\n"
                               "  Band: 1\n"
                               "  Channel: 65535\n"
                               "  Pilot: 65535\n");
}

TEST_F(ReselectionCandidatesListTest, ShowsOnlyThePriorityOfAnUnknownTechnology)
{
    for (const unsigned technology : {5U, 7U, 256U, 65535U}) {
        section.receive(0xB186, candidate(technology).u32(25, 0xFFFFFFFF));
        EXPECT_EQ(section.shown(), "-\n"
                                   "  Candidate Priority: 5\n"
                                   "  Candidate RAT Type: ??\n")
            << technology;
    }
}

TEST_F(ReselectionCandidatesListTest, ReadsTheFieldsOfACandidateOutOfTheOnesBehindIt)
{
    section.receive(
        0xB186,
        PacketBuilder(33).u16(19, 3).u16(21, 5).u16(23, 3).u16(25, 0x0406).u16(27, 9).u16(29, 2).u16(31, 8));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Candidate Priority: 5\n"
                               "  Candidate RAT Type: CDMA1XRTT\n"
                               "  Band: 6\n"
                               "  Channel: 2\n"
                               "  Pilot: 8\n"
                               "-\n"
                               "  Candidate Priority: 1030\n"
                               "  Candidate RAT Type: ??\n"
                               "-\n"
                               "  Candidate Priority: 2\n"
                               "  Candidate RAT Type: ??\n");
}

TEST_F(ReselectionCandidatesListTest, CountsByTheLowEightBits)
{
    section.receive(0xB186, candidate(0));
    EXPECT_EQ(section.rowCount(), 1U);
    section.receive(0xB186, PacketBuilder(21 + 4 * 300).u16(19, 256));
    EXPECT_EQ(section.rowCount(), 0U);
    section.receive(0xB186, PacketBuilder(21 + 4 * 300).u16(19, 258));
    EXPECT_EQ(section.rowCount(), 2U);
    section.receive(0xB186, PacketBuilder(21 + 4 * 300).u16(19, 255));
    EXPECT_EQ(section.rowCount(), 255U);
    section.receive(0xB186, PacketBuilder(21));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST_F(ReselectionCandidatesListTest, KeepsNoRowOfAnOlderCandidate)
{
    section.receive(0xB186, candidate(3));
    section.receive(0xB186, candidate(7));
    section.receive(0xB186, candidate(1));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Candidate Priority: 5\n"
                               "  Candidate RAT Type: UTRAN\n"
                               "  U ARFCN: 0\n"
                               "  PSC: 0\n");
}

TEST_F(ReselectionCandidatesListTest, ReadsZeroBeyondThePacket)
{
    section.receive(0xB186, candidate(3).u8(25, 10).u16(29, 476).u16(31, 0x0168).length(32));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Candidate Priority: 5\n"
                               "  Candidate RAT Type: CDMA1XRTT\n"
                               "  Band: 10\n"
                               "  Channel: 476\n"
                               "  Pilot: 104\n"); // the low byte only
    section.receive(0xB186, candidate(0).u16(25, 6300).length(25));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Candidate Priority: 5\n"
                               "  Candidate RAT Type: LTE\n"
                               "  E ARFCN: 0\n"
                               "  Cell ID: 0\n");
}

TEST_F(ReselectionCandidatesListTest, ShowsTheCandidatesWhoseFirstFourBytesThePacketHolds)
{
    forEachPrefix(PacketBuilder(21 + 18).u16(19, 255).bytes(), [this](const LogPacket& packet) {
        section.section.updateWithData(packet, 0xB186);
        const std::size_t shown = packet.size() < 21 ? 0 : (packet.size() - 21) / 4;
        EXPECT_EQ(section.rowCount(), shown) << packet.size();
    });
}

TEST_F(ReselectionCandidatesListTest, KeepsTheListWhenThePacketIsOneByteShort)
{
    section.receive(0xB186, candidate(0));
    section.logged();
    section.receive(0xB186, PacketBuilder(20));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_THAT(section.logged(), ElementsAre("<4>Reselection Candidates List"));
}

TEST_F(ReselectionCandidatesListTest, LogsAForeignCodeAndKeepsTheList)
{
    section.receive(0xB186, candidate(0));
    section.logged();
    section.receive(0xB180, PacketBuilder(21));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Reselection Candidates List", "<3>Received an unknown log message: 45440"));
}

} // namespace
} // namespace pelorus::test
