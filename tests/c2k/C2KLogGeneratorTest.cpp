#include "LogGenerator/C2K/C2KLogGenerator.h"

#include "tests/generator/GeneratorFixture.h"
#include "tests/support/SectionFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// Messages on their way to the decoders, and what is kept of them.
class C2KMessages : public GeneratorFixture {
protected:
    C2KMessages()
    {
        platform.addResource("C2KTemplate",
                             propertyListText("<dict><key>Rate</key><string>k1xTrafficFER</string>"
                                              "<key>Color</key><string>kColorCode</string></dict>"));
        generator.generateLogUsingState(state);
        log.take();
    }

    static PacketBuilder packet(unsigned type, unsigned code, std::size_t length = 13)
    {
        return PacketBuilder(length).u8(0, type).u16(3, code);
    }
    static PacketBuilder summary(unsigned type, unsigned color)
    {
        return packet(type, 0x1183, 50).u8(41, color);
    }
    static PacketBuilder prefixed(const PacketBuilder& packet)
    {
        return PacketBuilder(2).u8(0, 0x81).u8(1, 0x7F).raw(packet.bytes());
    }
    void receive(const PacketBuilder& message) { generator.updateState(state, message.bytes()); }
    std::string color() { return *state.at("Display").dictionary()->at("Color").string(); }
    /// The raw messages that the next refresh hands over.
    Bytes kept()
    {
        generator.generateLogUsingState(state);
        return *state.at("DisplayState").data();
    }

    C2KLogGenerator generator{platform};
};

TEST_F(C2KMessages, AreDecodedWithAndWithoutPrefix)
{
    receive(summary(1, 7));
    EXPECT_EQ(color(), "7");
    receive(prefixed(summary(1, 8)));
    EXPECT_EQ(color(), "8");
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(C2KMessages, LoseOnePrefixOnly)
{
    receive(prefixed(prefixed(summary(1, 8))));
    EXPECT_THAT(log.take(), ElementsAre("<3>Invalid log type: 81. Dropping."));
    EXPECT_EQ(color(), "");
    EXPECT_THAT(kept(), IsEmpty());
}

TEST_F(C2KMessages, BelowThirteenBytesAreIgnored)
{
    receive(PacketBuilder(0));
    receive(packet(2, 0x1183, 12));
    EXPECT_THAT(log.take(), IsEmpty());
    EXPECT_THAT(kept(), IsEmpty());
    receive(packet(1, 0x1183, 13));
    EXPECT_THAT(log.take(), ElementsAre("<3>Log code 0x1183 is 13 bytes long but should be 50 bytes."));
    EXPECT_EQ(kept().size(), 13U);
}

// The line says that it is dropped, and yet it is decoded: meant.
TEST_F(C2KMessages, OfAnotherTypeAreDecodedAllTheSame)
{
    receive(summary(2, 9));
    EXPECT_THAT(log.take(), ElementsAre("<3>Invalid log type: 2. Dropping."));
    EXPECT_EQ(color(), "9");
    EXPECT_EQ(kept(), summary(2, 9).bytes());
    receive(summary(0, 10));
    EXPECT_THAT(log.take(), ElementsAre("<3>Invalid log type: 0. Dropping."));
    EXPECT_EQ(color(), "10");
}

TEST_F(C2KMessages, OfTheTelephonyServerHaveNoKnownCode)
{
    receive(summary(0xFF, 9));
    EXPECT_THAT(log.take(), ElementsAre("<3>Invalid log type: ff. Dropping."));
    EXPECT_EQ(color(), "");
    EXPECT_THAT(kept(), IsEmpty());
}

TEST_F(C2KMessages, OfAnUnlistedCodeAreNotKept)
{
    for (const unsigned code : {0x0000U, 0x1182U, 0x1184U, 0x8311U, 0x12B5U, 0xB179U, 0xFFFFU})
        receive(packet(1, code, 50));
    EXPECT_THAT(log.take(), IsEmpty());
    EXPECT_THAT(kept(), IsEmpty());
}

TEST_F(C2KMessages, OfElevenBytesBehindThePrefixAreRejectedByEveryDecoderAndKept)
{
    const char* const lines[] = {"<3>Log code 0x108a is 11 bytes long but must be at least 23 bytes.",
                                 "<3>Log code 0x1183 is 11 bytes long but should be 50 bytes.",
                                 "<3>Log code 0x1192 is 11 bytes long but must be at least 241 bytes.",
                                 "<3>Log code 0x12b6 is 11 bytes long but must be at least 25 bytes.",
                                 "<3>Log code 0x119c is 11 bytes long but must be at least 17 bytes.",
                                 "<3>Log code 0x119d is 11 bytes long but must be at least 17 bytes.",
                                 "<3>Log code 0x127e is 11 bytes long but must be at least 1750 bytes.",
                                 "<3>Log code 0x134f is 11 bytes long but must be at least 171 bytes."};
    const unsigned codes[] = {0x108A, 0x1183, 0x1192, 0x12B6, 0x119C, 0x119D, 0x127E, 0x134F};
    for (std::size_t index = 0; index < std::size(codes); ++index) {
        receive(prefixed(packet(1, codes[index], 11)));
        EXPECT_THAT(log.take(), ElementsAre(lines[index]));
        EXPECT_EQ(kept(), packet(1, codes[index], 11).bytes());
    }
}

TEST_F(C2KMessages, AreKeptWithoutTheirPrefixUntilTheRefresh)
{
    receive(prefixed(summary(1, 7)));
    receive(summary(1, 8));
    Bytes both = summary(1, 7).bytes();
    const Bytes second = summary(1, 8).bytes();
    both.insert(both.end(), second.begin(), second.end());
    EXPECT_EQ(kept(), both);
    EXPECT_THAT(kept(), IsEmpty());
}

TEST_F(C2KMessages, ReachTheHistoryAndTheDlfFile)
{
    receive(summary(1, 7));
    generator.generateLogUsingState(state);
    receive(summary(1, 8));
    const auto contents = generator.getSaveContentsFromState(state);
    ASSERT_EQ(contents->elements.size(), 3U); // the empty one of the start, this one, the DLF file
    const Dictionary& shown = *contents->elements[1].dictionary();
    EXPECT_EQ(shown.at("Display").dictionary()->at("Color"), Value("7"));
    EXPECT_EQ(*shown.at("DisplayState").data(), summary(1, 7).bytes());
    EXPECT_EQ(contents->elements[2].dictionary()->at("Description"), Value("DLF binary (210 bytes)"));
}

TEST_F(C2KMessages, OfASecondLookupArePublishedThere)
{
    const auto group = makeDictionary();
    const auto lookup =
        makeDictionary({{"kColorCode", makeArray({makeDictionary({{"key", "Row"}, {"dict", group}})})}});
    generator.updateFromLog(summary(1, 7).bytes(), lookup, state);
    EXPECT_EQ(textOf(group), "Row: 7\n");
    EXPECT_EQ(color(), "");
    receive(summary(1, 8));
    EXPECT_EQ(textOf(group), "Row: 7\n");
    EXPECT_EQ(color(), "8");
}

TEST_F(C2KMessages, StopAtTheFirstEntryOfTheLookupThatIsNone)
{
    const auto first = makeDictionary();
    const auto later = makeDictionary();
    const Value good = makeDictionary({{"key", "Row"}, {"dict", first}});
    const Value last = makeDictionary({{"key", "Row"}, {"dict", later}});
    for (const Value& bad :
         {Value("text"), Value(makeDictionary({{"key", "Row"}})), Value(makeDictionary({{"dict", later}})),
          Value(makeDictionary({{"key", 1}, {"dict", later}})),
          Value(makeDictionary({{"key", "Row"}, {"dict", "none"}}))}) {
        first->clear();
        generator.updateFromLog(summary(1, 7).bytes(),
                                makeDictionary({{"kColorCode", makeArray({good, bad, last})}}), state);
        EXPECT_EQ(textOf(first), "Row: 7\n");
        EXPECT_TRUE(later->empty());
    }
    generator.updateFromLog(summary(1, 8).bytes(), makeDictionary({{"kColorCode", good}}), state);
    EXPECT_EQ(textOf(first), "Row: 7\n"); // no array
}

TEST_F(C2KMessages, RowsMayComeAndGoInTheDisplayMeanwhile)
{
    receive(summary(1, 7));
    Dictionary& display = *state.at("Display").dictionary();
    display.remove("Rate");
    for (int row = 0; row < 100; ++row)
        display.set(fmt::format("{}", row), "x");
    display.set(Label("Color"), "changed");
    receive(summary(1, 7));
    EXPECT_EQ(color(), "7");
    display.remove("Color");
    receive(summary(1, 7));
    EXPECT_EQ(color(), "7");
}

} // namespace
} // namespace pelorus::test
