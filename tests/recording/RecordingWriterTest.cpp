#include "tests/recording/RecordingFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::SizeIs;

class Writer : public RecordingFixture {
protected:
    std::unique_ptr<RecordingWriter> create()
    {
        auto writer = RecordingWriter::create(path, why);
        EXPECT_NE(writer, nullptr) << why;
        return writer;
    }
    std::string path = directory / "written.pcap";
};

TEST_F(Writer, RoundTripKeepsBytesAndNanoseconds)
{
    const Bytes one = message(1, 0xB179, "payload");
    const Bytes two = prefixed(message(0xFF, 2), 0xAB);
    auto writer = create();
    EXPECT_TRUE(writer->write({at(1336123800, 123'456'789), one}));
    EXPECT_TRUE(writer->write({at(1336123800, 123'456'790), two}));
    EXPECT_TRUE(writer->write({at(1336123801, 999'999'999), {}}));
    writer.reset();
    EXPECT_THAT(readAll(path), ElementsAre(one, two, Bytes()));
    EXPECT_THAT(times, ElementsAre(at(1336123800, 123'456'789), at(1336123800, 123'456'790),
                                   at(1336123801, 999'999'999)));
    EXPECT_EQ(why, "");
}

TEST_F(Writer, FileIsANanosecondPcapOfUser0)
{
    create().reset();
    std::ifstream file(path, std::ifstream::binary);
    std::array<unsigned char, 64> bytes{};
    file.read(reinterpret_cast<char*>(bytes.data()), bytes.size());
    EXPECT_EQ(file.gcount(), 24);
    EXPECT_THAT(std::vector(bytes.begin(), bytes.begin() + 4), ElementsAre(0x4D, 0x3C, 0xB2, 0xA1));
    EXPECT_THAT(std::vector(bytes.begin() + 20, bytes.begin() + 24), ElementsAre(147, 0, 0, 0));
}

TEST_F(Writer, FlushedMessagesAreInTheFile)
{
    auto writer = create();
    const Bytes one = message(1, 0xB179);
    writer->write({at(1), one});
    EXPECT_TRUE(writer->flush());
    EXPECT_THAT(readAll(path), ElementsAre(one));
}

TEST_F(Writer, LongestMessageIsTakenAndALongerOneIsNot)
{
    auto writer = create();
    const Bytes longest(262'144, std::byte{0x55});
    const Bytes tooLong(262'145);
    EXPECT_TRUE(writer->write({at(1), longest}));
    EXPECT_FALSE(writer->write({at(2), tooLong}));
    EXPECT_TRUE(writer->write({at(3), message(1, 1)}));
    writer.reset();
    const auto messages = readAll(path);
    ASSERT_THAT(messages, SizeIs(2));
    EXPECT_EQ(messages[0], longest);
    EXPECT_EQ(times[1], at(3));
}

TEST_F(Writer, FileThatCannotBeMadeIsRefused)
{
    EXPECT_EQ(RecordingWriter::create(directory / "missing" / "file", why), nullptr);
    EXPECT_EQ(why, "No such file or directory");
    EXPECT_EQ(RecordingWriter::create(directory, why), nullptr);
    EXPECT_EQ(why, "Is a directory");
}

TEST_F(Writer, FullDiskIsNoticed)
{
    if (!std::filesystem::exists("/dev/full"))
        GTEST_SKIP() << "no /dev/full";
    path = "/dev/full";
    auto writer = create();
    writer->write({at(1), message(1, 0xB179)});
    EXPECT_FALSE(writer->flush());
}

} // namespace
} // namespace pelorus::test
