#include "tests/c2k/C2KFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class SystemIdentity : public C2KFixture {
protected:
    SystemIdentity()
        : C2KFixture(
              {"k1xRoamingHome", "kSystemId", "kNetworkId", "kPacketZoneId", "kBaseId", "kProtocolRevision"})
    {}
    static PacketBuilder packet()
    {
        return PacketBuilder(186)
            .u8(13, 2)
            .u32(42, 1)
            .u32(46, 2)
            .u16(50, 4183)
            .u16(52, 65535)
            .u8(131, 200)
            .u8(133, 6)
            .u16(184, 51966);
    }
};

TEST_F(SystemIdentity, ShowsEveryRow)
{
    receive(0x134F, packet());
    EXPECT_EQ(shown(), "k1xRoamingHome: ON [1]\n"
                       "kSystemId: 4183\n"
                       "kNetworkId: 65535\n"
                       "kPacketZoneId: 200\n"
                       "kBaseId: 51966\n"
                       "kProtocolRevision: 6\n");
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(SystemIdentity, NamesEveryRoamingIndicator)
{
    const char* const texts[] = {"OFF [0]",
                                 "ON [1]",
                                 "Flashing [2]",
                                 "Out of Neighborhood [3]",
                                 "Out of Building [4]",
                                 "Preferred system [5]",
                                 "Available system [6]",
                                 "Alliance partner [7]",
                                 "Premium partner [8]",
                                 "Full service functionality [9]",
                                 "Partial service functionality [10]",
                                 "Banner ON [11]",
                                 "Banner OFF [12]",
                                 "ERI - 13"};
    for (unsigned indicator = 0; indicator < std::size(texts); ++indicator) {
        receive(0x134F, packet().u32(42, indicator));
        EXPECT_EQ(row("k1xRoamingHome"), texts[indicator]);
    }
    receive(0x134F, packet().u32(42, 256));
    EXPECT_EQ(row("k1xRoamingHome"), "ERI - 256");
    receive(0x134F, packet().u32(42, 0x7FFFFFFF));
    EXPECT_EQ(row("k1xRoamingHome"), "ERI - 2147483647");
    receive(0x134F, packet().u32(42, 0x80000000));
    EXPECT_EQ(row("k1xRoamingHome"), "ERI - -2147483648");
    receive(0x134F, packet().u32(42, 0xFFFFFFFF));
    EXPECT_EQ(row("k1xRoamingHome"), "ERI - -1");
}

TEST_F(SystemIdentity, KnowsTheIdentifiersOfOneSystemType)
{
    for (const auto& [type, text] :
         {std::pair{0x1U, "(unknown system type 1)"}, std::pair{0x3U, "(unknown system type 3)"},
          std::pair{0x102U, "(unknown system type 258)"},
          std::pair{0xFFFFFFFFU, "(unknown system type -1)"}}) {
        receive(0x134F, packet());
        EXPECT_EQ(row("kSystemId"), "4183");
        receive(0x134F, packet().u32(46, type));
        EXPECT_EQ(row("kSystemId"), text);
        EXPECT_EQ(row("kNetworkId"), text);
        EXPECT_EQ(row("kBaseId"), "51966");
    }
}

TEST_F(SystemIdentity, IsMoreThan170BytesLong)
{
    receive(0x134F, packet().length(170));
    EXPECT_THAT(log.take(),
                ElementsAre("<3>Log code 0x134f is 170 bytes long but must be at least 171 bytes."));
    EXPECT_EQ(row("kSystemId"), "");
    receive(0x134F, packet().length(171));
    EXPECT_EQ(row("kSystemId"), "4183");
    EXPECT_EQ(row("kProtocolRevision"), "6");
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(SystemIdentity, StationIsZeroWhereThePacketEndsBeforeIt)
{
    // At 185 bytes the low byte of 0xCAFE is there.
    for (const auto& [length, text] : {std::pair{186U, "51966"}, std::pair{172U, "0"}, std::pair{184U, "0"},
                                       std::pair{185U, "254"}, std::pair{187U, "51966"}}) {
        receive(0x134F, packet().length(length));
        EXPECT_EQ(row("kBaseId"), text) << length;
    }
}

TEST_F(SystemIdentity, IsOfVersion2OrLater)
{
    receive(0x134F, packet().u8(13, 0));
    receive(0x134F, packet().u8(13, 1));
    EXPECT_THAT(
        log.take(),
        ElementsAre("<3>Log code 0x134f has version=0; only version 2 or higher expected; dropping.",
                    "<3>Log code 0x134f has version=1; only version 2 or higher expected; dropping."));
    EXPECT_EQ(row("kSystemId"), "");
    receive(0x134F, packet().u8(13, 255));
    EXPECT_EQ(row("kSystemId"), "4183");
}

} // namespace
} // namespace pelorus::test
