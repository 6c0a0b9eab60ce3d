#include "tests/c2k/C2KFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class PilotReports : public C2KFixture {
protected:
    PilotReports() : C2KFixture({"kActiveSetPilots", "kFingerC2I"}) {}

    static PacketBuilder activeSet(unsigned count)
    {
        return PacketBuilder(25 + std::size_t{12} * count).u8(15, count);
    }
    static PacketBuilder fingers(unsigned count)
    {
        return PacketBuilder(23 + std::size_t{14} * count).u8(22, count);
    }
};

TEST_F(PilotReports, ActiveSetShowsEachPilotBehindItsIndex)
{
    receive(0x12B6,
            activeSet(3).u16(25, 132).u16(27, 256).u16(37, 4).u16(39, 1024).u16(49, 65535).u16(51, 1));
    EXPECT_EQ(row("kActiveSetPilots"), "_sorted: _sorted\n"
                                       "0;132: -3.01 dB\n"
                                       "1;4: +3.01 dB\n"
                                       "2;65535: -27.09 dB\n");
    EXPECT_EQ(row("kFingerC2I"), "");
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(PilotReports, FingersShowEachPilotBehindItsIndex)
{
    receive(0x108A, fingers(2).u16(23, 132).u16(29, 512).u16(37, 132).u16(43, 65535));
    EXPECT_EQ(row("kFingerC2I"), "_sorted: _sorted\n"
                                 "0;132: +0.00 dB\n"
                                 "1;132: +21.07 dB\n");
    EXPECT_EQ(row("kActiveSetPilots"), "");
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(PilotReports, NoPilotsAreNone)
{
    receive(0x12B6, activeSet(1));
    receive(0x12B6, activeSet(0));
    EXPECT_EQ(row("kActiveSetPilots"), "(none)");
    receive(0x108A, fingers(0));
    EXPECT_EQ(row("kFingerC2I"), "(none)");
}

TEST_F(PilotReports, UnassignedFingersUseUpTheirIndex)
{
    receive(0x108A, fingers(3).u16(23, 0xFFFF).u16(37, 7).u16(43, 5120).u16(51, 0xFFFF));
    EXPECT_EQ(row("kFingerC2I"), "_sorted: _sorted\n1;7: +10.00 dB\n");
    receive(0x108A, fingers(2).u16(23, 0xFFFF).u16(37, 0xFFFF));
    EXPECT_EQ(row("kFingerC2I"), "(none)");
    receive(0x108A, fingers(1).u16(23, 0xFFFE).u16(29, 512));
    EXPECT_EQ(row("kFingerC2I"), "_sorted: _sorted\n0;65534: +0.00 dB\n");
}

TEST_F(PilotReports, ActiveSetKeepsAPilotOf65535)
{
    receive(0x12B6, activeSet(1).u16(25, 0xFFFF).u16(27, 512));
    EXPECT_EQ(row("kActiveSetPilots"), "_sorted: _sorted\n0;65535: +0.00 dB\n");
}

TEST_F(PilotReports, NoEnergyIsMinusInfinity)
{
    receive(0x12B6, activeSet(1).u16(25, 3));
    EXPECT_EQ(row("kActiveSetPilots"), "_sorted: _sorted\n0;3: -inf dB\n");
    receive(0x108A, fingers(1).u16(23, 3));
    EXPECT_EQ(row("kFingerC2I"), "_sorted: _sorted\n0;3: -inf dB\n");
}

TEST_F(PilotReports, ActiveSetMayBeLongerThanItsPilots)
{
    receive(0x12B6, activeSet(0).length(24));
    EXPECT_THAT(log.take(),
                ElementsAre("<3>Log code 0x12b6 is 24 bytes long but must be at least 25 bytes."));
    EXPECT_EQ(row("kActiveSetPilots"), "");
    receive(0x12B6, activeSet(2).length(48));
    EXPECT_THAT(log.take(), ElementsAre("<3>Log code 0x12b6 is 48 bytes long, but has 2 substructs."));
    EXPECT_EQ(row("kActiveSetPilots"), "");
    receive(0x12B6, activeSet(1).u16(27, 512).length(38));
    EXPECT_EQ(row("kActiveSetPilots"), "_sorted: _sorted\n0;0: +0.00 dB\n");
    receive(0x12B6, activeSet(0).length(26));
    EXPECT_EQ(row("kActiveSetPilots"), "(none)");
    EXPECT_THAT(log.take(), IsEmpty());
}

// The size in the second message is that without any finger: meant.
TEST_F(PilotReports, FingersHaveExactlyTheirLength)
{
    receive(0x108A, fingers(0).length(22));
    EXPECT_THAT(log.take(),
                ElementsAre("<3>Log code 0x108a is 22 bytes long but must be at least 23 bytes."));
    receive(0x108A, fingers(2).length(50));
    receive(0x108A, fingers(2).length(52));
    receive(0x108A, fingers(0).length(24));
    EXPECT_THAT(
        log.take(),
        ElementsAre("<3>Log code 0x108a has bad length of 50 bytes, but has 2 substructs (size=23).",
                    "<3>Log code 0x108a has bad length of 52 bytes, but has 2 substructs (size=23).",
                    "<3>Log code 0x108a has bad length of 24 bytes, but has 0 substructs (size=23)."));
    EXPECT_EQ(row("kFingerC2I"), "");
    receive(0x108A, fingers(2).u16(29, 512).u16(43, 512));
    EXPECT_EQ(row("kFingerC2I"), "_sorted: _sorted\n0;0: +0.00 dB\n1;0: +0.00 dB\n");
}

TEST_F(PilotReports, MayHave255Pilots)
{
    receive(0x12B6, activeSet(255).u16(25 + 12 * 254, 511).u16(27 + 12 * 254, 1024));
    EXPECT_EQ(value("kActiveSetPilots").dictionary()->size(), 256U);
    EXPECT_EQ(value("kActiveSetPilots").dictionary()->at("254;511"), Value("+3.01 dB"));
    receive(0x12B6, activeSet(255).length(3084));
    EXPECT_THAT(log.take(), ElementsAre("<3>Log code 0x12b6 is 3084 bytes long, but has 255 substructs."));
    receive(0x108A, fingers(255).u16(23 + 14 * 254, 511).u16(29 + 14 * 254, 1024));
    EXPECT_EQ(value("kFingerC2I").dictionary()->size(), 256U);
    EXPECT_EQ(value("kFingerC2I").dictionary()->at("254;511"), Value("+3.01 dB"));
    receive(0x108A, fingers(255).length(23 + 14 * 255 - 1));
    EXPECT_THAT(
        log.take(),
        ElementsAre("<3>Log code 0x108a has bad length of 3592 bytes, but has 255 substructs (size=23)."));
}

TEST_F(PilotReports, AnotherPilotOrStrengthReplacesTheOneBefore)
{
    receive(0x12B6, activeSet(2).u16(25, 1).u16(27, 512).u16(37, 2).u16(39, 512));
    receive(0x12B6, activeSet(2).u16(25, 1).u16(27, 256).u16(37, 3).u16(39, 512));
    EXPECT_EQ(row("kActiveSetPilots"), "_sorted: _sorted\n0;1: -3.01 dB\n1;3: +0.00 dB\n");
    receive(0x12B6, activeSet(1).u16(25, 1).u16(27, 256));
    EXPECT_EQ(row("kActiveSetPilots"), "_sorted: _sorted\n0;1: -3.01 dB\n");
    receive(0x12B6, activeSet(2).u16(25, 1).u16(27, 256).u16(37, 2).u16(39, 1024));
    EXPECT_EQ(row("kActiveSetPilots"), "_sorted: _sorted\n0;1: -3.01 dB\n1;2: +3.01 dB\n");
}

TEST_F(PilotReports, AListThatWasHandedOutStaysAsItWas)
{
    receive(0x12B6, activeSet(1).u16(25, 1).u16(27, 512));
    const Value before = value("kActiveSetPilots");
    receive(0x12B6, activeSet(1).u16(25, 1).u16(27, 256));
    EXPECT_EQ(textOf(before), "_sorted: _sorted\n0;1: +0.00 dB\n");
}

} // namespace
} // namespace pelorus::test
