#include "platform/recording/SnapshotRecording.h"
#include "tests/recording/RecordingFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

class SnapshotRecordings : public RecordingFixture {
protected:
    std::string writeList(const Value& list, PropertyListForm form = PropertyListForm::xml)
    {
        return write(serializePropertyList(list, form).value());
    }
    static Value snapshot(std::vector<Value> entries)
    {
        return makeDictionary({{"Timestamp", "2012-05-04 09:30:10 +0000"},
                               {"Data", makeArray(std::move(entries))},
                               {"Description", ""}});
    }
    static Value entry(const Bytes& messages, std::string_view date = "2012-05-04 09:30:00 +0000")
    {
        return makeDictionary(
            {{"DisplayState", makeData(messages)}, {"Display", makeDictionary()}, {"Date", date}});
    }
};

TEST_F(SnapshotRecordings, GiveTheMessagesOfEveryEntryInOrder)
{
    const Bytes one = message(1, 0xB179, "abc");
    const Bytes two = prefixed(message(1, 0xB180), 0x07);
    const Bytes three = message(0xFF, 0x0001, "bplist00");
    const Bytes four = prefixed(message(0xFF, 0x0000, "x"));
    const Value list = snapshot({entry(joined({one, two, three})), entry(Bytes()),
                                 entry(joined({four, one}), "2012-05-04 09:30:02 +0000")});
    for (const PropertyListForm form : {PropertyListForm::xml, PropertyListForm::binary}) {
        EXPECT_THAT(readAll(writeList(list, form)), ElementsAre(one, two, three, four, one));
        EXPECT_THAT(times, ElementsAre(at(1336123800), at(1336123800), at(1336123800), at(1336123802),
                                       at(1336123802)));
        EXPECT_EQ(why, "");
    }
}

TEST_F(SnapshotRecordings, MessageOfAnyLogTypeIsGiven)
{
    EXPECT_THAT(readAll(writeList(snapshot({entry(message(0x02, 0xB179))}))),
                ElementsAre(message(0x02, 0xB179)));
}

TEST_F(SnapshotRecordings, EntriesWithoutRawMessagesArePassedOver)
{
    const Bytes one = message(1, 0xB179);
    EXPECT_THAT(
        readAll(writeList(snapshot(
            {makeDictionary(), "text", makeDictionary({{"DisplayState", makeDictionary()}}), entry(one),
             makeDictionary({{"Description", "DLF binary (3 bytes)"}, {"DLF", makeData(Bytes(3))}})}))),
        ElementsAre(one));
    EXPECT_EQ(why, "");
}

TEST_F(SnapshotRecordings, WithoutSaveContentsHaveNoMessages)
{
    EXPECT_THAT(readAll(writeList(makeDictionary({{"Timestamp", "2012-05-04 09:30:10 +0000"}}))), IsEmpty());
    EXPECT_EQ(why, "");
}

TEST_F(SnapshotRecordings, BrokenRawMessagesEndTheReading)
{
    const Bytes one = message(1, 0xB179);
    const Value list = snapshot({makeDictionary(), entry(one), entry(joined({one, Bytes(5)})), entry(one)});
    EXPECT_THAT(readAll(writeList(list)), ElementsAre(one, one));
    EXPECT_EQ(why, "raw messages of entry 2 make no sense from byte 13 on");
}

TEST_F(SnapshotRecordings, RecordLengthsAreChecked)
{
    const auto broken = [this](unsigned length, std::size_t size) {
        const Bytes bytes = BytesBuilder().u8(1).u16(length).zeros(size - 3).bytes();
        EXPECT_THAT(readAll(writeList(snapshot({entry(bytes)}))), IsEmpty());
        return why == "raw messages of entry 0 make no sense from byte 0 on";
    };
    EXPECT_TRUE(broken(0, 13));
    EXPECT_TRUE(broken(11, 13));
    EXPECT_TRUE(broken(13, 13));
    EXPECT_TRUE(broken(0xFFFF, 13));
    EXPECT_TRUE(broken(12, 12));
}

TEST_F(SnapshotRecordings, DateThatMakesNoSenseIs1970)
{
    const Bytes one = message(1, 0xB179);
    for (const char* date : {"", "yesterday", "2012-05-04", "2012-05-04 09:30:00"}) {
        EXPECT_THAT(readAll(writeList(snapshot({entry(one, date)}))), SizeIs(1));
        EXPECT_THAT(times, ElementsAre(at(0)));
    }
    readAll(writeList(snapshot({makeDictionary({{"DisplayState", makeData(one)}, {"Date", 5}})})));
    EXPECT_THAT(times, ElementsAre(at(0)));
}

TEST_F(SnapshotRecordings, DateOfAnotherZone)
{
    EXPECT_EQ(timeOfDateText("2012-05-04 06:00:00 -0330"), at(1336123800));
    EXPECT_EQ(timeOfDateText("2012-05-04 15:15:00 +0545"), at(1336123800));
}

TEST_F(SnapshotRecordings, DateBeyondAllMeasureIsHarmless)
{
    EXPECT_GT(timeOfDateText("9999-12-31 23:59:59 +0000"), at(8'000'000'000 - 1));
    EXPECT_LT(timeOfDateText("0000-01-01 00:00:00 +0000"), at(-7'999'999'999));
}

TEST_F(SnapshotRecordings, PropertyListThatIsNoSnapshotIsRefused)
{
    constexpr const char* reason = "a property list, but no snapshot";
    EXPECT_EQ(refusal(writeList(makeDictionary())), reason);
    EXPECT_EQ(refusal(writeList(makeArray({"Timestamp"}))), reason);
    EXPECT_EQ(refusal(writeList("Timestamp")), reason);
    EXPECT_EQ(refusal(writeList(makeDictionary({{"Data", makeArray()}}))), reason);
    EXPECT_EQ(refusal(writeList(makeDictionary({{"Timestamp", "x"}, {"Data", "y"}}))), reason);
}

TEST_F(SnapshotRecordings, HostilePropertyListsAreRefused)
{
    for (const std::string& text :
         {std::string("<"), std::string("<plist>"), std::string("<?xml version=\"1.0\"?>"),
          std::string("<html><body/></html>"), std::string("bplist00"), std::string("bplist"),
          "<plist version=\"1.0\">" +
              [] {
                  std::string nested;
                  for (int level = 0; level < 100'000; ++level)
                      nested += "<array>";
                  return nested;
              }(),
          std::string("<!DOCTYPE a [<!ENTITY x \"xxxxxxxxxx\"><!ENTITY y \"&x;&x;&x;&x;\">]>"
                      "<plist version=\"1.0\"><string>&y;</string></plist>"),
          "bplist00" + std::string(64, '\xFF')})
        EXPECT_NE(refusal(write(text)), "") << text.substr(0, 40);
}

TEST_F(SnapshotRecordings, BlanksAndByteOrderMarkMayComeFirst)
{
    const Bytes list = serializePropertyList(makeDictionary({{"Timestamp", "x"}})).value();
    const std::string text(reinterpret_cast<const char*>(list.data()), list.size());
    const std::string body = text.substr(text.find("<plist"));
    EXPECT_EQ(refusal(write("\n\n  " + body)), "");
    EXPECT_EQ(refusal(write("\xEF\xBB\xBF" + text)), "");
}

TEST_F(SnapshotRecordings, FileThatIsTooLongIsRefused)
{
    const std::string path = write("<plist version=\"1.0\">");
    std::filesystem::resize_file(path, 256 * 1024 * 1024 + 1);
    EXPECT_EQ(refusal(path), "268435457 bytes, too long for a snapshot");
}

} // namespace
} // namespace pelorus::test
