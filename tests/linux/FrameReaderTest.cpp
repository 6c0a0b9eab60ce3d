#include "platform/linux/FrameReader.h"

#include "tests/linux/PortFixture.h"

#include <cstring>
#include <gmock/gmock.h>

namespace pelorus {

using test::oneWay;
using test::wireFrame;

namespace {

/// The frames as text, "id/kind/sequence:payload", "-" for no data.
std::vector<std::string> framesOf(FrameReader& reader)
{
    std::vector<std::string> frames;
    while (const auto frame = reader.next()) {
        std::string payload(frame->payload.size(), ' ');
        if (!payload.empty())
            std::memcpy(payload.data(), frame->payload.data(), payload.size());
        frames.push_back(std::to_string(frame->id) + "/" + std::to_string(int(frame->kind)) + "/" +
                         std::to_string(frame->sequence) + ":" + (frame->hasData ? payload : "-"));
    }
    return frames;
}

std::vector<std::string> feed(FrameReader& reader, std::string_view bytes)
{
    std::vector<std::string> frames;
    while (!bytes.empty()) {
        const auto room = reader.room();
        const auto count = std::min(room.size(), bytes.size());
        std::memcpy(room.data(), bytes.data(), count);
        bytes.remove_prefix(count);
        reader.received(count);
        for (auto& frame : framesOf(reader))
            frames.push_back(std::move(frame));
    }
    return frames;
}

using testing::ElementsAre;
using testing::IsEmpty;

} // namespace

TEST(Frame, HeaderIsFourLittleEndianFields)
{
    const std::string payload = "abc";
    const auto header = FrameHeader::pack({.id = -2,
                                           .kind = FrameKind::request,
                                           .sequence = 0x01020304,
                                           .payload = std::as_bytes(std::span(payload))});
    const unsigned char expected[] = {3, 0, 0, 0, 0xFE, 0xFF, 0xFF, 0xFF, 1, 0, 0, 0, 4, 3, 2, 1};
    ASSERT_EQ(header.size(), 16u);
    EXPECT_EQ(std::memcmp(header.data(), expected, 16), 0);
}

TEST(Frame, ReplyWithoutDataHasTheLengthOfAllOnes)
{
    const auto header = FrameHeader::pack({.kind = FrameKind::reply, .sequence = 7, .hasData = false});
    const unsigned char expected[] = {0xFF, 0xFF, 0xFF, 0xFF, 0, 0, 0, 0, 2, 0, 0, 0, 7, 0, 0, 0};
    EXPECT_EQ(std::memcmp(header.data(), expected, 16), 0);
}

TEST(FrameReader, PutsTogetherWhatWasSplitAtAnyByte)
{
    const std::string stream = oneWay("first", 3) + wireFrame(0, -1, 1, 9) +
                               wireFrame(0xFFFFFFFF, 0, 2, 0xFFFFFFFE) + wireFrame(2, 5, 2, 8, "ok");
    for (std::size_t split = 0; split <= stream.size(); ++split) {
        FrameReader reader;
        auto frames = feed(reader, stream.substr(0, split));
        for (auto& frame : feed(reader, stream.substr(split)))
            frames.push_back(frame);
        EXPECT_THAT(frames, ElementsAre("3/0/0:first", "-1/1/9:", "0/2/4294967294:-", "5/2/8:ok")) << split;
        EXPECT_TRUE(reader.isBetweenFrames());
    }
    FrameReader reader;
    std::vector<std::string> frames;
    for (const char byte : stream)
        for (auto& frame : feed(reader, std::string(1, byte)))
            frames.push_back(frame);
    EXPECT_THAT(frames, ElementsAre("3/0/0:first", "-1/1/9:", "0/2/4294967294:-", "5/2/8:ok"));
}

TEST(FrameReader, CutsManyFramesOutOfOneChunk)
{
    std::string stream;
    for (int number = 0; number < 5000; ++number)
        stream += oneWay(std::string(static_cast<std::size_t>(number % 300), 'x'), number);
    FrameReader reader;
    const auto frames = feed(reader, stream);
    ASSERT_EQ(frames.size(), 5000u);
    EXPECT_EQ(frames[0], "0/0/0:");
    EXPECT_EQ(frames[4502], "4502/0/0:xx");
    EXPECT_EQ(reader.capacity(), 65536u);
}

TEST(FrameReader, SmallPayloadIsAViewOfWhereItWasRead)
{
    FrameReader reader;
    const auto room = reader.room();
    const std::string stream = oneWay("abcd");
    std::memcpy(room.data(), stream.data(), stream.size());
    reader.received(stream.size());
    EXPECT_EQ(reader.next()->payload.data(), room.data() + 16);
}

TEST(FrameReader, LargestFrameIsTakenAndItsMemoryGivenBack)
{
    const std::string payload(16777216, 'p');
    FrameReader reader;
    const auto frames = feed(reader, oneWay(payload) + oneWay("next"));
    ASSERT_EQ(frames.size(), 2u);
    EXPECT_EQ(frames[0].size(), std::string("0/0/0:").size() + 16777216);
    EXPECT_EQ(frames[1], "0/0/0:next");
    reader.room();
    EXPECT_EQ(reader.capacity(), 65536u);
}

TEST(FrameReader, AnnouncementAloneTakesNoMemory)
{
    FrameReader reader;
    EXPECT_THAT(feed(reader, wireFrame(16777216, 0, 0, 0, "only these")), IsEmpty());
    reader.room();
    EXPECT_EQ(reader.capacity(), 65536u);
    EXPECT_FALSE(reader.isBetweenFrames());
    EXPECT_FALSE(reader.isCutOff());
}

TEST(FrameReader, NeverHoldsMoreThanOneLargestFrame)
{
    FrameReader reader;
    feed(reader, wireFrame(16777216, 0, 0, 0, std::string(16777215, 'p')));
    EXPECT_LE(reader.room().size(), 1u);
    EXPECT_EQ(reader.capacity(), 16777216u);
}

TEST(FrameReader, OneByteTooManyIsCutOff)
{
    FrameReader reader;
    EXPECT_THAT(feed(reader, oneWay("good") + wireFrame(16777217, 0, 0, 0, "x") + oneWay("lost")),
                ElementsAre("0/0/0:good"));
    EXPECT_TRUE(reader.isCutOff());
    EXPECT_EQ(reader.reason(), "frame of 16777217 bytes announced, at most 16777216 are allowed");
}

TEST(FrameReader, UnknownKindIsCutOff)
{
    FrameReader reader;
    EXPECT_THAT(feed(reader, wireFrame(0, 0, 3, 0)), IsEmpty());
    EXPECT_TRUE(reader.isCutOff());
    EXPECT_EQ(reader.reason(), "frame of unknown kind 3");
}

TEST(FrameReader, OnlyAReplyMayCarryNoData)
{
    for (const std::uint32_t kind : {0u, 1u}) {
        FrameReader reader;
        EXPECT_THAT(feed(reader, wireFrame(0xFFFFFFFF, 0, kind, 1)), IsEmpty());
        EXPECT_TRUE(reader.isCutOff());
    }
}

} // namespace pelorus
