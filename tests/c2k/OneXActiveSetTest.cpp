#include "LogGenerator/C2K/OneXActiveSet.h"

#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

/// The subpacket up to its pilots.
PacketBuilder head(unsigned a, unsigned b, unsigned c, unsigned count, unsigned k, unsigned reference)
{
    return PacketBuilder(12).u16(4, a).u8(6, b).u8(7, c).u8(8, count).u8(9, k).u16(10, reference);
}

std::string textOfSet(const PacketBuilder& subpacket)
{
    return textOf(oneXActiveSet(PacketView(subpacket.bytes()), nullptr));
}

/// What one pilot shows that is not the reference.
std::string strength(unsigned a, unsigned b, unsigned c, unsigned energy)
{
    const auto set =
        oneXActiveSet(PacketView(head(a, b, c, 1, 1, 9).u16(12, 5).u16(28, energy).bytes()), nullptr);
    return *set->at("0;5").string();
}

// With a k of 1 a record has 20 bytes and the energy is at 16.
TEST(OneXActiveSet, ShowsEachPilotAndTheReference)
{
    EXPECT_EQ(textOfSet(head(8, 4, 3, 3, 1, 144)
                            .u16(12, 132)
                            .u16(28, 200)
                            .u16(32, 144)
                            .u16(48, 100)
                            .u16(52, 132)
                            .u16(68, 40)),
              "_sorted: _sorted\n"
              "0;132: -2.45 dB\n"
              "1;144: (ref pilot) -6.53 dB\n"
              "2;132: -18.57 dB\n");
}

TEST(OneXActiveSet, WithoutPilotsIsTheMarkAlone)
{
    EXPECT_EQ(textOfSet(head(8, 4, 3, 0, 1, 144).u16(12, 132)), "_sorted: _sorted\n");
    EXPECT_EQ(textOfSet(PacketBuilder(0)), "_sorted: _sorted\n");
}

TEST(OneXActiveSet, StrengthsFollowTheFormula)
{
    EXPECT_EQ(strength(8, 4, 3, 37), "-24.59 dB");
    EXPECT_EQ(strength(100, 10, 2, 40000), "-11.03 dB");
    EXPECT_EQ(strength(1, 1, 0, 65535), "+29.59 dB");
    EXPECT_EQ(strength(1, 1, 255, 65535), "+1564.84 dB");
    EXPECT_EQ(strength(65535, 255, 255, 65535), "+1444.45 dB");
}

TEST(OneXActiveSet, StrengthsEndAtMinus50)
{
    EXPECT_EQ(strength(8, 4, 3, 36), "-50.00 dB"); // exactly the noise
    EXPECT_EQ(strength(8, 4, 3, 35), "-50.00 dB");
    EXPECT_EQ(strength(8, 4, 3, 0), "-50.00 dB");
    EXPECT_EQ(strength(0, 4, 3, 200), "-50.00 dB");
    EXPECT_EQ(strength(8, 0, 3, 200), "-50.00 dB");
    EXPECT_EQ(strength(0, 0, 255, 65535), "-50.00 dB");
}

// (6k + 15) rounded down to a multiple of 4 a record, the energy at 12 + 4k.
TEST(OneXActiveSet, RecordsGrowWithK)
{
    // k 0: 12 bytes, so the energy is where the next record begins.
    EXPECT_EQ(textOfSet(head(8, 4, 3, 2, 0, 9).u16(12, 5).u16(24, 200).u16(36, 100)),
              "_sorted: _sorted\n0;5: -2.45 dB\n1;200: -6.53 dB\n");
    // k 2: 24 bytes, energy at 20.
    EXPECT_EQ(textOfSet(head(8, 4, 3, 2, 2, 9).u16(12, 5).u16(32, 200).u16(36, 6).u16(56, 100)),
              "_sorted: _sorted\n0;5: -2.45 dB\n1;6: -6.53 dB\n");
    // k 3: 33 rounded down to 32 bytes, energy at 24.
    EXPECT_EQ(textOfSet(head(8, 4, 3, 2, 3, 9).u16(12, 5).u16(36, 200).u16(44, 6).u16(68, 100)),
              "_sorted: _sorted\n0;5: -2.45 dB\n1;6: -6.53 dB\n");
    // k 255: 1544 bytes, energy at 1032.
    EXPECT_EQ(textOfSet(head(8, 4, 3, 2, 255, 9).u16(12, 5).u16(1044, 200).u16(1556, 6).u16(2588, 100)),
              "_sorted: _sorted\n0;5: -2.45 dB\n1;6: -6.53 dB\n");
}

TEST(OneXActiveSet, PilotsBehindTheEndAreZero)
{
    EXPECT_EQ(textOfSet(head(8, 4, 3, 3, 1, 0).u16(12, 5).u16(28, 200)), "_sorted: _sorted\n"
                                                                         "0;5: -2.45 dB\n"
                                                                         "1;0: (ref pilot) -50.00 dB\n"
                                                                         "2;0: (ref pilot) -50.00 dB\n");
    // The first byte of the energy is there.
    EXPECT_EQ(textOfSet(head(8, 4, 3, 1, 1, 9).u16(12, 5).u16(28, 200).length(29)),
              "_sorted: _sorted\n0;5: -2.45 dB\n");
    const auto most = oneXActiveSet(PacketView(head(8, 4, 3, 255, 255, 9).bytes()), nullptr);
    EXPECT_EQ(most->size(), 256U);
    EXPECT_EQ(most->at("254;0"), Value("-50.00 dB"));
}

TEST(OneXActiveSet, ChangesWithEverythingThatItIsMadeOf)
{
    const auto before =
        oneXActiveSet(PacketView(head(8, 4, 3, 1, 1, 9).u16(12, 5).u16(28, 200).bytes()), nullptr);
    const auto after = [&before](const PacketBuilder& subpacket) {
        return textOf(oneXActiveSet(PacketView(subpacket.bytes()), before.get()));
    };
    EXPECT_EQ(after(head(8, 4, 3, 1, 1, 9).u16(12, 5).u16(28, 200)), "_sorted: _sorted\n0;5: -2.45 dB\n");
    EXPECT_EQ(after(head(8, 4, 3, 1, 1, 5).u16(12, 5).u16(28, 200)),
              "_sorted: _sorted\n0;5: (ref pilot) -2.45 dB\n");
    EXPECT_EQ(after(head(8, 4, 3, 1, 1, 9).u16(12, 5).u16(28, 100)), "_sorted: _sorted\n0;5: -6.53 dB\n");
    EXPECT_EQ(after(head(0, 4, 3, 1, 1, 9).u16(12, 5).u16(28, 200)), "_sorted: _sorted\n0;5: -50.00 dB\n");
    EXPECT_EQ(after(head(8, 0, 3, 1, 1, 9).u16(12, 5).u16(28, 200)), "_sorted: _sorted\n0;5: -50.00 dB\n");
    EXPECT_EQ(after(head(8, 4, 1, 1, 1, 9).u16(12, 5).u16(28, 200)), "_sorted: _sorted\n0;5: -50.00 dB\n");
    EXPECT_EQ(after(head(8, 4, 3, 1, 1, 9).u16(12, 6).u16(28, 200)), "_sorted: _sorted\n0;6: -2.45 dB\n");
    EXPECT_EQ(textOf(before), "_sorted: _sorted\n0;5: -2.45 dB\n");
}

} // namespace
} // namespace pelorus::test
