#include "LogGenerator/Osprey/OSPLogGenerator.h"
#include "tests/generator/GeneratorFixture.h"

#include <algorithm>

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::SizeIs;

class OspreyGenerator : public OSPLogGenerator {
public:
    explicit OspreyGenerator(Platform& system) : OSPLogGenerator(system) {}
};

class Dlf : public GeneratorFixture {
protected:
    Dlf()
    {
        platform.setNow(std::chrono::sys_days{2012y / 5 / 4} + 9h + 30min + 999ms);
        state.set("History", makeArray());
    }

    void record(Value displayState)
    {
        state.find("History")->array()->elements.emplace_back(
            makeDictionary({{"DisplayState", std::move(displayState)}}));
    }
    void record(std::initializer_list<unsigned> bytes)
    {
        Bytes content;
        for (const unsigned byte : bytes)
            content.push_back(static_cast<std::byte>(byte));
        record(makeData(content));
    }
    Bytes dlf() const { return generator.generateDlfFromState(state).value(); }
    /// The bytes behind the version report.
    std::vector<unsigned> records() const
    {
        std::vector<unsigned> rest;
        const Bytes all = dlf();
        std::transform(all.begin() + 161, all.end(), std::back_inserter(rest),
                       [](std::byte byte) { return std::to_integer<unsigned>(byte); });
        return rest;
    }
    std::string textAt(std::size_t place, std::size_t width) const
    {
        const Bytes all = dlf();
        return {reinterpret_cast<const char*>(all.data()) + place, width};
    }
    unsigned u16At(std::size_t place) const
    {
        const Bytes all = dlf();
        return std::to_integer<unsigned>(all.at(place)) | std::to_integer<unsigned>(all.at(place + 1)) << 8;
    }

    OspreyGenerator generator{platform};
};

TEST_F(Dlf, OfAnEmptyHistoryIsTheVersionReport)
{
    EXPECT_THAT(dlf(), SizeIs(161));
    state.clear();
    EXPECT_THAT(dlf(), SizeIs(161));
    EXPECT_EQ(u16At(0), 0x00A1U);
    EXPECT_EQ(u16At(2), 0x1FFDU);
    EXPECT_EQ(textAt(4, 8), std::string(8, '\0'));
    EXPECT_EQ(u16At(12), 1U);
    EXPECT_EQ(u16At(14), 1U);
    EXPECT_EQ(textAt(23, 16), std::string("EXECUTABLE_NAME\0", 16));
    EXPECT_EQ(textAt(39, 24), std::string(24, '\0'));
    EXPECT_THAT(textAt(63, 17),
                MatchesRegex("[A-Z][a-z][a-z] [ 1-3][0-9] 20[0-9][0-9] [0-2][0-9]:[0-5][0-9]"));
    EXPECT_EQ(textAt(80, 1), std::string(1, '\0'));
    EXPECT_EQ(u16At(81), 0xA198U);
    EXPECT_EQ(u16At(83), 0x4FA3U);
    EXPECT_EQ(textAt(89, 72), std::string(72, '\0'));
}

TEST_F(Dlf, VersionTextIsCutToSix)
{
    EXPECT_EQ(textAt(16, 7), std::string("Peloru\0", 7));
    platform.version = "";
    EXPECT_EQ(textAt(16, 7), std::string("Peloru\0", 7));
    platform.version = std::nullopt;
    EXPECT_EQ(textAt(16, 7), std::string("(none)\0", 7));
}

TEST_F(Dlf, ZoneOffsetIsInMinutes)
{
    platform.zone = {-(3h + 30min), false};
    EXPECT_EQ(u16At(85), 0xFF2EU); // -210
    platform.zone = {5h + 45min, false};
    EXPECT_EQ(u16At(85), 345U);
    platform.zone = {0s, false};
    EXPECT_EQ(u16At(85), 0U);
}

TEST_F(Dlf, ZoneOffsetIsCutTowardsZero)
{
    platform.zone = {-119s, false};
    EXPECT_EQ(u16At(85), 0xFFFFU); // -1
    platform.zone = {119s, false};
    EXPECT_EQ(u16At(85), 1U);
    platform.zone = {-59s, false};
    EXPECT_EQ(u16At(85), 0U);
}

TEST_F(Dlf, DaylightSavingIsAFlag)
{
    EXPECT_EQ(u16At(87), 0U);
    platform.zone = {2h, true};
    EXPECT_EQ(u16At(87), 1U);
    EXPECT_EQ(u16At(85), 120U);
}

TEST_F(Dlf, OnlyTheFirstByteOfEachSnapshotGoes)
{
    record({1, 0x0C, 0x00, 0x34, 0x12, 1, 0x0D});
    record({0x81, 0x00, 0xFF, 0x0E});
    EXPECT_THAT(records(), ElementsAre(0x0C, 0x00, 0x34, 0x12, 1, 0x0D, 0x00, 0xFF, 0x0E));
}

TEST_F(Dlf, SnapshotOfOneByteOrLessGivesNothing)
{
    record(makeData({}));
    record({0x01});
    EXPECT_THAT(records(), IsEmpty());
    record({0x01, 0x02});
    EXPECT_THAT(records(), ElementsAre(0x02));
}

TEST_F(Dlf, SnapshotWithoutMessagesIsSkipped)
{
    state.find("History")->array()->elements.emplace_back(makeDictionary());
    record({0x01, 0x02});
    EXPECT_THAT(records(), ElementsAre(0x02));
}

TEST_F(Dlf, IsNotMadeFromAnotherClass)
{
    record({0x01, 0x02});
    record(makeDictionary());
    EXPECT_EQ(generator.generateDlfFromState(state), std::nullopt);
    EXPECT_THAT(log.take(),
                ElementsAre("<16>Got wrong class writing history to DLF; aborting writing the DLF file"));
    for (const Value& wrong : {Value("text"), Value(1), Value(makeArray())}) {
        state.set("History", makeArray());
        record(wrong);
        EXPECT_EQ(generator.generateDlfFromState(state), std::nullopt);
    }
}

TEST_F(Dlf, SaveContentsEndWithIt)
{
    record({0x01, 0x02, 0x03});
    const auto contents = generator.getSaveContentsFromState(state);
    ASSERT_THAT(contents->elements, SizeIs(2));
    EXPECT_EQ(contents->elements[0], state.at("History").array()->elements[0]);
    const Dictionary& entry = *contents->elements[1].dictionary();
    EXPECT_EQ(entry.size(), 2U);
    EXPECT_EQ(entry.at("Description"), Value("DLF binary (163 bytes)"));
    EXPECT_EQ(entry.at("DLF"), Value(makeData(dlf())));
    EXPECT_THAT(state.at("History").array()->elements, SizeIs(1));
}

TEST_F(Dlf, SaveContentsOfAnEmptyHistory)
{
    const auto contents = generator.getSaveContentsFromState(state);
    ASSERT_THAT(contents->elements, SizeIs(1));
    EXPECT_EQ(contents->elements[0].dictionary()->at("Description"), Value("DLF binary (161 bytes)"));
}

TEST_F(Dlf, SaveContentsWithoutItAreTheHistoryAlone)
{
    record(makeDictionary());
    const auto contents = generator.getSaveContentsFromState(state);
    EXPECT_THAT(contents->elements, SizeIs(1));
}

} // namespace
} // namespace pelorus::test
