#include "LogGenerator/Osprey/OSPLogGenerator2.h"
#include "platform/scripted/ScriptedPlatform.h"
#include "tests/recording/RecordingFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

/// A version report of 2012-05-04 09:30:00.
Bytes versionReport()
{
    return BytesBuilder().u16(161).u16(0x1FFD).zeros(77).u32(1336123800).zeros(76).bytes();
}

/// A generator without sections: it only keeps what it receives.
class KeepingGenerator : public OSPLogGenerator2 {
public:
    explicit KeepingGenerator(Platform& system) : OSPLogGenerator2(system) {}
};

class DlfRecordings : public RecordingFixture {
protected:
    /// The DLF file that a saved snapshot of these refreshes carries.
    static Bytes saved(const std::vector<std::vector<Bytes>>& refreshes)
    {
        ScriptedPlatform platform;
        platform.setNow(std::chrono::sys_seconds{1336123800s});
        KeepingGenerator generator(platform);
        State state;
        for (const auto& messages : refreshes) {
            for (const Bytes& one : messages)
                generator.updateState(state, one);
            generator.generateLogUsingState(state);
        }
        return generator.generateDlfFromState(state).value();
    }
    /// Reads it back, but for the version report at its start.
    std::vector<Bytes> readBack(const Bytes& dlf)
    {
        auto messages = readAll(write(dlf));
        if (messages.empty())
            return {};
        EXPECT_THAT(messages.front(), SizeIs(162));
        messages.erase(messages.begin());
        return messages;
    }
};

TEST_F(DlfRecordings, GiveEachRecordBehindALogTypeOfOne)
{
    const Bytes file = BytesBuilder()
                           .raw(versionReport())
                           .raw(record(0xB179, "abc"))
                           .raw(record(0xB180))
                           .raw(record(0x0001, "x"))
                           .bytes();
    EXPECT_THAT(readAll(write(file)),
                ElementsAre(BytesBuilder().u8(1).raw(versionReport()).bytes(), message(1, 0xB179, "abc"),
                            message(1, 0xB180), message(1, 0x0001, "x")));
    EXPECT_THAT(times, testing::Each(at(1336123800)));
    EXPECT_EQ(why, "");
}

TEST_F(DlfRecordings, OfAnEmptyHistoryHoldsTheVersionReport)
{
    const auto messages = readAll(write(saved({})));
    ASSERT_THAT(messages, SizeIs(1));
    EXPECT_THAT(messages[0], SizeIs(162));
    EXPECT_THAT(times, ElementsAre(at(1336123800)));
}

TEST_F(DlfRecordings, WellFormedRecordsAreNeverTakenForFraming)
{
    // Records whose payload ends in what looks like a log-type byte and a prefix.
    const Bytes file = BytesBuilder()
                           .raw(versionReport())
                           .raw(record(0x0101, "\x01\x01\x01"))
                           .raw(record(0xFFFF, "\x81\xFF\x01"))
                           .raw(record(0x0101))
                           .bytes();
    EXPECT_THAT(readBack(file), ElementsAre(message(1, 0x0101, "\x01\x01\x01"),
                                            message(1, 0xFFFF, "\x81\xFF\x01"), message(1, 0x0101)));
}

TEST_F(DlfRecordings, SavedWithOneMessageARefreshReadBack)
{
    const Bytes one = message(1, 0xB179, "abc");
    const Bytes two = message(1, 0xB180);
    EXPECT_THAT(readBack(saved({{one}, {two}, {}, {one}})), ElementsAre(one, two, one));
}

TEST_F(DlfRecordings, SavedWithSeveralMessagesARefreshReadBack)
{
    const Bytes one = message(1, 0xB179, "abc");
    const Bytes two = message(1, 0xB180, std::string(300, 'x'));
    const Bytes three = message(0xFF, 0x0001, "bplist00");
    EXPECT_THAT(readBack(saved({{one, two, three}, {two, three, one}, {one}})),
                ElementsAre(one, two, three, two, three, one, one));
    EXPECT_EQ(why, "");
}

TEST_F(DlfRecordings, SavedWithPrefixesReadBackWithoutThem)
{
    const Bytes one = message(1, 0xB179, "abc");
    const Bytes two = message(0xFF, 0x0002, "bplist00");
    EXPECT_THAT(readBack(saved({{prefixed(one, 0x00), prefixed(two, 0x05), one, prefixed(one, 0xFF)},
                                {prefixed(two, 0x01), two, prefixed(two, 0x81)},
                                {one, prefixed(one)}})),
                ElementsAre(one, two, one, one, two, two, two, one, one));
    EXPECT_EQ(why, "");
}

// The log-type byte of a refresh's first message is not in the file.
TEST_F(DlfRecordings, FirstMessageOfARefreshReadsBackAsOneOfTheBaseband)
{
    const Bytes list = message(0xFF, 0x0001, "bplist00");
    EXPECT_THAT(readBack(saved({{list, list}})), ElementsAre(message(1, 0x0001, "bplist00"), list));
}

TEST_F(DlfRecordings, SavedRandomMessagesReadBack)
{
    std::uint32_t seed = 12345;
    const auto random = [&seed](unsigned below) {
        seed = seed * 1664525 + 1013904223;
        return (seed >> 8) % below;
    };
    for (int round = 0; round < 200; ++round) {
        std::vector<std::vector<Bytes>> refreshes(5);
        std::vector<Bytes> expected;
        for (auto& messages : refreshes)
            for (unsigned count = 1 + random(6); count > 0; --count) {
                std::string payload(random(200), 'x');
                for (char& byte : payload)
                    byte = static_cast<char>(random(256));
                const Bytes one = message(1, random(0x10000), payload);
                expected.push_back(one);
                messages.push_back(random(3) == 0 ? prefixed(one, random(256)) : one);
            }
        ASSERT_TRUE(readBack(saved(refreshes)) == expected) << "round " << round;
    }
}

TEST_F(DlfRecordings, CutVersionReportIsRefused)
{
    const Bytes report = versionReport();
    EXPECT_EQ(refusal(write(startOf(report, 160))),
              "a DLF file whose version report is cut short, 160 bytes");
    EXPECT_EQ(refusal(write(startOf(report, 4))), "a DLF file whose version report is cut short, 4 bytes");
}

TEST_F(DlfRecordings, CutRecordEndsTheReading)
{
    const Bytes file =
        BytesBuilder().raw(versionReport()).raw(record(0xB179, "abc")).raw(record(0xB180, "defg")).bytes();
    for (std::size_t length = 177; length < 192; ++length) {
        const Bytes start = startOf(file, length);
        EXPECT_THAT(readBack(start), ElementsAre(message(1, 0xB179, "abc")));
        EXPECT_EQ(why, "no whole log record at byte 176 of " + std::to_string(length));
    }
}

TEST_F(DlfRecordings, GarbageBehindTheVersionReportEndsTheReading)
{
    EXPECT_THAT(readBack(BytesBuilder().raw(versionReport()).zeros(40).bytes()), IsEmpty());
    EXPECT_EQ(why, "no whole log record at byte 161 of 201");
}

} // namespace
} // namespace pelorus::test
