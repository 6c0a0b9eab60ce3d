#include "tests/recording/PcapFile.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

class PcapRecordings : public RecordingFixture {};

TEST_F(PcapRecordings, MicrosecondsAreRead)
{
    PcapFile file(PcapFile::kMicroseconds);
    file.packet(1336123800, 999999, message(1, 0xB179)).packet(1336123801, 0, prefixed(message(0xFF, 1)));
    EXPECT_THAT(readAll(write(file.bytes())), ElementsAre(message(1, 0xB179), prefixed(message(0xFF, 1))));
    EXPECT_THAT(times, ElementsAre(at(1336123800, 999'999'000), at(1336123801)));
    EXPECT_EQ(why, "");
}

TEST_F(PcapRecordings, NanosecondsAreRead)
{
    PcapFile file(PcapFile::kNanoseconds);
    file.packet(1336123800, 999999999, message(1, 0xB179)).packet(1336123801, 1, message(1, 0xB180));
    EXPECT_THAT(readAll(write(file.bytes())), SizeIs(2));
    EXPECT_THAT(times, ElementsAre(at(1336123800, 999'999'999), at(1336123801, 1)));
}

TEST_F(PcapRecordings, OtherByteOrderIsRead)
{
    const auto swap = [](std::uint32_t word) { return __builtin_bswap32(word); };
    BytesBuilder file;
    file.u32(swap(0xA1B2C3D4)).u16(0x0200).u16(0x0400).u32(0).u32(0).u32(swap(262144)).u32(swap(147));
    file.u32(swap(7)).u32(swap(5)).u32(swap(13)).u32(swap(13)).raw(message(1, 0xB179));
    EXPECT_THAT(readAll(write(file.bytes())), ElementsAre(message(1, 0xB179)));
    EXPECT_THAT(times, ElementsAre(at(7, 5'000)));
}

TEST_F(PcapRecordings, PcapngIsRead)
{
    PcapngFile file;
    file.packet(1'336'123'800'000'001, message(1, 0xB179, "x")).packet(1'336'123'800'000'002, Bytes());
    EXPECT_THAT(readAll(write(file.bytes())), ElementsAre(message(1, 0xB179, "x"), Bytes()));
    EXPECT_THAT(times, ElementsAre(at(1336123800, 1'000), at(1336123800, 2'000)));
    EXPECT_EQ(why, "");
}

TEST_F(PcapRecordings, PcapngOfNanosecondsIsRead)
{
    PcapngFile file(147, 9);
    file.packet(1'336'123'800'000'000'001, message(1, 0xB179));
    EXPECT_THAT(readAll(write(file.bytes())), SizeIs(1));
    EXPECT_THAT(times, ElementsAre(at(1336123800, 1)));
}

TEST_F(PcapRecordings, TimesBeyondAllMeasureAreHarmless)
{
    PcapngFile file(147, 0); // whole seconds
    file.packet(0x7FFF'FFFF'FFFF'FFFF, message(1, 0xB179)).packet(~std::uint64_t{0}, message(1, 0xB180));
    EXPECT_THAT(readAll(write(file.bytes())), SizeIs(2));

    PcapFile another(PcapFile::kMicroseconds);
    another.packet(0xFFFFFFFF, 0xFFFFFFFF, message(1, 0xB179));
    EXPECT_THAT(readAll(write(another.bytes())), SizeIs(1));
}

TEST_F(PcapRecordings, WithoutPacketsIsARecording)
{
    EXPECT_THAT(readAll(write(PcapFile(PcapFile::kMicroseconds).bytes())), IsEmpty());
    EXPECT_EQ(why, "");
    EXPECT_THAT(readAll(write(PcapngFile().bytes())), IsEmpty());
    EXPECT_EQ(why, "");
}

TEST_F(PcapRecordings, OfAnotherLinkTypeAreRefused)
{
    EXPECT_EQ(refusal(write(PcapFile(PcapFile::kMicroseconds, 1).bytes())),
              "recorded from link type 1 (EN10MB), not from a log channel (147, USER0)");
    EXPECT_EQ(refusal(write(PcapngFile(148).bytes())),
              "recorded from link type 148 (unknown), not from a log channel (147, USER0)");
}

TEST_F(PcapRecordings, SecondInterfaceOfAnotherLinkTypeEndsTheReading)
{
    PcapngFile file;
    file.packet(1, message(1, 0xB179)).interface(1).packet(2, message(1, 0xB180), 1);
    EXPECT_THAT(readAll(write(file.bytes())), SizeIs(1));
    EXPECT_THAT(why, HasSubstr("broken after 1 messages: "));
}

TEST_F(PcapRecordings, CutHeaderIsRefused)
{
    const Bytes file = PcapFile(PcapFile::kMicroseconds).bytes();
    for (std::size_t length = 4; length < 24; ++length)
        EXPECT_THAT(refusal(write(startOf(file, length))), HasSubstr("truncated"));
}

TEST_F(PcapRecordings, CutPacketEndsTheReading)
{
    PcapFile file(PcapFile::kMicroseconds);
    file.packet(1, 0, message(1, 0xB179));
    const std::size_t whole = file.bytes().size();
    file.packet(2, 0, message(1, 0xB180));
    for (std::size_t length = whole + 1; length < file.bytes().size(); ++length) {
        const Bytes start = startOf(file.bytes(), length);
        EXPECT_THAT(readAll(write(start)), ElementsAre(message(1, 0xB179)));
        EXPECT_THAT(why, HasSubstr("broken after 1 messages: truncated"));
    }
}

TEST_F(PcapRecordings, PacketThatWasRecordedCutEndsTheReading)
{
    PcapFile file(PcapFile::kMicroseconds);
    file.packet(1, 0, message(1, 0xB179)).cutPacket(2, 0, message(1, 0xB180), 14);
    EXPECT_THAT(readAll(write(file.bytes())), SizeIs(1));
    EXPECT_EQ(why, "message 2 was recorded cut short, 13 of its 14 bytes");
}

TEST_F(PcapRecordings, PacketOfAnImpossibleLengthEndsTheReading)
{
    const Bytes file = BytesBuilder()
                           .raw(PcapFile(PcapFile::kMicroseconds).bytes())
                           .u32(1)
                           .u32(0)
                           .u32(0xFFFFFFF0)
                           .u32(0xFFFFFFF0)
                           .bytes();
    EXPECT_THAT(readAll(write(file)), IsEmpty());
    EXPECT_THAT(why, HasSubstr("broken after 0 messages: "));
}

} // namespace
} // namespace pelorus::test
