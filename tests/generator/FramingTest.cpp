#include "tests/generator/ProbeFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

class Framing : public ProbeFixture {
protected:
    void receive(const PacketBuilder& message) { generator.updateWithData(message.bytes()); }
    static PacketBuilder prefixed(const PacketBuilder& packet, unsigned second = 0)
    {
        return PacketBuilder(2).u8(0, 0x81).u8(1, second).raw(packet.bytes());
    }
};

TEST_F(Framing, PacketGoesToItsSubscribersWhole)
{
    const auto message = packet(1, 0x1234).u8(13, 0x55);
    receive(message);
    ASSERT_THAT(received(), SizeIs(1));
    EXPECT_EQ(received()[0].code, 0x1234U);
    EXPECT_EQ(received()[0].bytes, message.bytes());
    ASSERT_THAT(index->second->packets, SizeIs(1));
    EXPECT_EQ(index->second->packets[0].bytes, message.bytes());
}

TEST_F(Framing, PrefixOfTwoBytesIsRemoved)
{
    receive(prefixed(packet(1, 0x1234).u8(13, 0x55), 0xAA));
    ASSERT_THAT(received(), SizeIs(1));
    EXPECT_EQ(received()[0].bytes, packet(1, 0x1234).u8(13, 0x55).bytes());
}

TEST_F(Framing, MessageBelowThirteenBytesIsDroppedSilently)
{
    log.take();
    for (std::size_t length = 0; length < 13; ++length) {
        receive(packet(1, 0x1234).length(length));
        receive(prefixed(packet(1, 0x1234)).length(length));
        receive(packet(7, 0x1234).length(length));
    }
    EXPECT_THAT(received(), IsEmpty());
    EXPECT_THAT(log.take(), IsEmpty());
}

// The length is tested before the prefix goes: meant.
TEST_F(Framing, ThirteenBytesWithThePrefixAreEnough)
{
    receive(prefixed(packet(1, 0x1234)).length(13));
    ASSERT_THAT(received(), SizeIs(1));
    EXPECT_THAT(received()[0].bytes, SizeIs(11));
    EXPECT_EQ(received()[0].code, 0x1234U);
}

TEST_F(Framing, OtherLogTypesAreDropped)
{
    log.take();
    for (const unsigned type : {0U, 2U, 0x10U, 0x80U, 0x82U, 0xFEU})
        receive(packet(type, 0x1234));
    EXPECT_THAT(received(), IsEmpty());
    EXPECT_THAT(log.take(),
                ElementsAre("<3>Invalid log type: 0. Dropping.", "<3>Invalid log type: 2. Dropping.",
                            "<3>Invalid log type: 10. Dropping.", "<3>Invalid log type: 80. Dropping.",
                            "<3>Invalid log type: 82. Dropping.", "<3>Invalid log type: fe. Dropping."));
}

TEST_F(Framing, LogTypeBehindThePrefixCounts)
{
    log.take();
    receive(prefixed(packet(2, 0x1234)));
    EXPECT_THAT(log.take(), ElementsAre("<3>Invalid log type: 2. Dropping."));
    EXPECT_THAT(received(), IsEmpty());
}

TEST_F(Framing, OnlyOnePrefixIsRemoved)
{
    log.take();
    receive(prefixed(prefixed(packet(1, 0x1234))));
    EXPECT_THAT(log.take(), ElementsAre("<3>Invalid log type: 81. Dropping."));
}

TEST_F(Framing, InternalPacketsHaveCodesOfTheirOwn)
{
    receive(packet(0xFF, 0x0001));
    receive(packet(0x01, 0x0001));
    ASSERT_THAT(received(), SizeIs(2));
    EXPECT_EQ(received()[0].code, 0xFF0001U);
    EXPECT_EQ(received()[1].code, 0x0001U);
    receive(prefixed(packet(0xFF, 0x0001)));
    EXPECT_EQ(received()[2].code, 0xFF0001U);
}

TEST_F(Framing, CodeWithoutSubscribersDoesNothing)
{
    log.take();
    receive(packet(0xFF, 0x1234));
    receive(packet(1, 0x3412));
    EXPECT_THAT(received(), IsEmpty());
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(Framing, ExceptionOfASectionIsNotCaught)
{
    index->first->throws = true;
    EXPECT_THROW(receive(packet(1, 0x1234)), ArrayOutOfBoundsException);
    EXPECT_THAT(index->second->packets, IsEmpty());
}

TEST_F(Framing, GeneratorWithoutAnIndexDecodesNothing)
{
    UninitialisedGenerator bare(platform);
    log.take();
    bare.updateWithData(packet(1, 0x1234).bytes());
    EXPECT_THAT(log.take(), IsEmpty());
    bare.updateWithData(packet(3, 0x1234).bytes());
    EXPECT_THAT(log.take(), ElementsAre("<3>Invalid log type: 3. Dropping."));
}

} // namespace
} // namespace pelorus::test
