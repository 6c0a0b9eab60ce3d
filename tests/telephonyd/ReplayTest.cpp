#include "platform/recording/PcapRecording.h"
#include "tests/support/PacketBuilder.h"
#include "tests/telephonyd/ServerFixture.h"

#include <filesystem>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

std::vector<std::byte> packet(unsigned type, unsigned mark)
{
    return PacketBuilder(14).u8(0, type).u8(1, 13).u16(3, 0xB179).u8(13, mark).bytes();
}

class ReplayTest : public ServerFixture {
protected:
    /// A recording whose messages are a second apart.
    std::string write(const std::vector<std::vector<std::byte>>& messages)
    {
        std::string why;
        const std::string file = recordings.filePath("recording").toStdString();
        const auto writer = RecordingWriter::create(file, why);
        EXPECT_TRUE(writer) << why;
        RecordedTime time{1000s};
        for (const auto& message : messages)
            EXPECT_TRUE(writer->write({time += 1s, message}));
        return file;
    }

    static std::vector<int> marks(const TestClient& client)
    {
        std::vector<int> result;
        for (const auto& message : client.messages)
            result.push_back(std::to_integer<int>(message.back()));
        return result;
    }

    QTemporaryDir recordings;
};

} // namespace

TEST_F(ReplayTest, PlaysABrokenRecordingUpToTheBreakAndSaysSo)
{
    const std::string file = write({packet(1, 1), packet(1, 2), packet(1, 3)});
    std::filesystem::resize_file(file, std::filesystem::file_size(file) - 5);
    serve(replayed(file, Pace::ownTiming(0)));
    TestClient client("client");
    client.run();
    ASSERT_TRUE(spinUntil([&] { return client.messages.size() == 2; }));
    ASSERT_TRUE(
        spinUntil([&] { return lines.back() == "Osprey LTE: channel 1: that was the last message"; }));
    EXPECT_THAT(marks(client), ElementsAre(1, 2));
    EXPECT_THAT(lines[lines.size() - 2], StartsWith(file + ": broken after 2 messages"));
    EXPECT_TRUE(client.isOpen());
}

TEST_F(ReplayTest, ReportsABrokenRecordingOnceHoweverOftenItLoops)
{
    const std::string file = write({packet(1, 1), packet(1, 2)});
    std::filesystem::resize_file(file, std::filesystem::file_size(file) - 5);
    serve(replayed(file, Pace::ownTiming(0), true));
    TestClient client("client");
    client.run();
    ASSERT_TRUE(spinUntil([&] { return client.messages.size() >= 10; }));
    EXPECT_EQ(std::count_if(lines.begin(), lines.end(),
                            [&](const std::string& line) { return line.starts_with(file); }),
              1);
}

TEST_F(ReplayTest, GivesAnIfxClientMessagesWithoutCodesToo)
{
    TelephonyServer::Settings settings =
        replayed(write({packet(1, 1), {std::byte{2}}, packet(7, 3)}), Pace::ownTiming(0));
    settings.technology = "IFX";
    serve(std::move(settings));
    TestClient client("client");
    client.createChannel();
    client.connectCommands();
    client.send(*serializePropertyList(makeDictionary({{"SetState", "Streaming"}})));
    ASSERT_TRUE(spinUntil([&] { return client.messages.size() == 3; }));
    EXPECT_THAT(marks(client), ElementsAre(1, 2, 3));
}

TEST_F(ReplayTest, HasNoBasebandOnceTheRecordingIsGone)
{
    const std::string file = write({packet(1, 1)});
    serve(replayed(file, Pace::ownTiming(0)));
    std::filesystem::remove(file);
    TestClient client("client");
    EXPECT_EQ(client.createChannel(), 2);
    EXPECT_THAT(lines.back(), HasSubstr(file));
}

TEST_F(ReplayTest, RecordsWhatFitsIntoARecording)
{
    const std::string file = recordings.filePath("record").toStdString();
    std::string why;
    auto recorder = MessageRecorder::create(
        file, [this](const std::string& line) { lines.push_back(line); }, why);
    ASSERT_TRUE(recorder) << why;
    const std::vector<std::byte> longest(262144, std::byte{1});
    const std::vector<std::byte> tooLong(262145, std::byte{2});
    const RecordedTime before = std::chrono::system_clock::now();
    recorder->record(longest);
    recorder->record(tooLong);
    recorder->record(packet(1, 9));
    const RecordedTime after = std::chrono::system_clock::now();
    EXPECT_THAT(lines,
                ElementsAre(file + ": a message of 262145 bytes is not recorded, 262144 are the most"));
    recorder.reset();

    const auto reader = RecordingReader::open(file, why);
    ASSERT_TRUE(reader) << why;
    RecordedMessage message;
    std::vector<std::size_t> lengths;
    while (reader->next(message) == RecordingReader::Next::message) {
        lengths.push_back(message.bytes.size());
        EXPECT_TRUE(before <= message.time && message.time <= after);
    }
    EXPECT_THAT(lengths, ElementsAre(262144U, 14U));
}

TEST_F(ReplayTest, RecordingThatCannotGoOnIsSaidOnceAndAtTheEnd)
{
    const auto recordTo = [this](const std::string& file) {
        std::string why;
        return MessageRecorder::create(
            file, [this](const std::string& line) { lines.push_back(line); }, why);
    };
    const auto full = recordTo("/dev/full");
    ASSERT_TRUE(full);
    for (int count = 0; count < 10000; ++count)
        full->record(packet(1, 9));
    EXPECT_FALSE(full->finish());
    EXPECT_THAT(lines, ElementsAre("/dev/full: cannot be written any more, the recording ends here: No space "
                                   "left on device"));
    const auto good = recordTo(recordings.filePath("record").toStdString());
    good->record(packet(1, 9));
    EXPECT_TRUE(good->finish());
}

TEST_F(ReplayTest, CannotRecordWhereNoFileCanBe)
{
    std::string why;
    EXPECT_FALSE(MessageRecorder::create(
        "/nowhere/at/all", [](const std::string&) {}, why));
    EXPECT_THAT(why, StartsWith("/nowhere/at/all: "));
}

} // namespace pelorus::test
