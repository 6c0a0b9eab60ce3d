#include "model/SnapshotFile.h"
#include "tests/model/ModelFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::vector<std::string> keysOf(const Value& dictionary)
{
    std::vector<std::string> keys;
    for (const auto& entry : *dictionary.dictionary())
        keys.emplace_back(entry.key.text());
    return keys;
}

TEST(SnapshotFile, HoldsTimestampDataAndDescription)
{
    const auto contents = makeArray({makeDictionary({{"Description", "Snapshot (now)"}})});
    const Value content = snapshotFileContent("2012-05-04 09:30:00 +0000", contents, "In the lift");
    EXPECT_THAT(keysOf(content), ElementsAre("Timestamp", "Data", "Description"));
    EXPECT_EQ(content.dictionary()->at("Timestamp"), Value("2012-05-04 09:30:00 +0000"));
    EXPECT_EQ(content.dictionary()->at("Data"), Value(contents));
    EXPECT_EQ(content.dictionary()->at("Description"), Value("In the lift"));
}

TEST(SnapshotFile, KeepsAnEmptyDescription)
{
    const Value content = snapshotFileContent("2012-05-04 09:30:00 +0000", makeArray(), "");
    EXPECT_THAT(keysOf(content), ElementsAre("Timestamp", "Data", "Description"));
    EXPECT_EQ(content.dictionary()->at("Description"), Value(""));
}

TEST(SnapshotFile, EndsAtTheFirstThatIsMissing)
{
    const Value content = snapshotFileContent("2012-05-04 09:30:00 +0000", nullptr, "In the lift");
    EXPECT_THAT(keysOf(content), ElementsAre("Timestamp"));
}

class WrittenSnapshot : public testing::Test {
protected:
    WrittenSnapshot() { platform.setNow(std::chrono::sys_seconds{1336123800s} + 999ms); }
    static Value saying(std::string_view text) { return snapshotFileContent(std::string(text), nullptr, ""); }

    RecordingLog log;
    ScriptedPlatform platform;
};

TEST_F(WrittenSnapshot, IsNamedAfterTheSecond)
{
    EXPECT_TRUE(writeSnapshotFile(platform, saying("one")));
    ASSERT_EQ(platform.written.size(), 1U);
    EXPECT_EQ(platform.written.begin()->first, "/crash-reports/PelorusSnapshot-1336123800.pelorus");
    EXPECT_EQ(platform.written.begin()->second, saying("one"));
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(WrittenSnapshot, ReplacesAnotherOfTheSameSecond)
{
    platform.setNow(std::chrono::sys_seconds{1336123800s});
    writeSnapshotFile(platform, saying("one"));
    platform.advance(999ms);
    writeSnapshotFile(platform, saying("two"));
    ASSERT_EQ(platform.written.size(), 1U);
    EXPECT_EQ(platform.written.begin()->second, saying("two"));
    platform.advance(1ms);
    writeSnapshotFile(platform, saying("three"));
    EXPECT_EQ(platform.written.size(), 2U);
    EXPECT_TRUE(platform.written.contains("/crash-reports/PelorusSnapshot-1336123801.pelorus"));
}

TEST_F(WrittenSnapshot, SaysWhenItCannotBeWritten)
{
    platform.writesFail = true;
    std::string why;
    EXPECT_FALSE(writeSnapshotFile(platform, saying("one"), &why));
    EXPECT_EQ(why, "/crash-reports/PelorusSnapshot-1336123800.pelorus: cannot be written");
    EXPECT_THAT(
        log.take(),
        ElementsAre("<3>Unable to write snapshot to /crash-reports/PelorusSnapshot-1336123800.pelorus"));
}

TEST_F(WrittenSnapshot, NamesTimesBeyond32Bits)
{
    platform.setNow(std::chrono::sys_seconds{5'000'000'000s});
    writeSnapshotFile(platform, saying("one"));
    EXPECT_TRUE(platform.written.contains("/crash-reports/PelorusSnapshot-5000000000.pelorus"));
}

} // namespace
} // namespace pelorus::test
