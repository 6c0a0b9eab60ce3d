#include "platform/Value.h"

#include <gtest/gtest.h>

#include <limits>

namespace pelorus {
namespace {

std::string keysOf(const Dictionary& dictionary)
{
    std::string keys;
    for (const auto& entry : dictionary)
        keys += std::string(entry.key.text()) + " ";
    return keys;
}

TEST(Value, TellsItsKindAndNilApart)
{
    EXPECT_FALSE(Value());
    EXPECT_TRUE(Value(""));
    EXPECT_EQ(*Value("text").string(), "text");
    EXPECT_EQ(*Value(-7).integer(), -7);
    EXPECT_EQ(*Value(0.5).real(), 0.5);
    EXPECT_EQ(*Value(false).boolean(), false);
    EXPECT_EQ(Value(1).boolean(), nullptr);
    EXPECT_EQ(Value(true).integer(), nullptr);
    EXPECT_EQ(Value("1").integer(), nullptr);
    EXPECT_EQ(Value(makeArray()).dictionary(), nullptr);
    EXPECT_EQ(Value(makeDictionary()).sharedArray(), nullptr);
    EXPECT_EQ(Value(makeData({std::byte{7}})).data()->front(), std::byte{7});
}

TEST(Value, TextTurnsAnotherKindIntoAnEmptyString)
{
    Value value(12);
    value.text() += "now text";
    EXPECT_EQ(*value.string(), "now text");
}

TEST(Value, CopiesShareTheirContainer)
{
    const Value first = makeArray({1});
    const Value second = first;
    second.array()->elements.emplace_back(2);
    EXPECT_EQ(first.array()->elements.size(), 2U);
    EXPECT_EQ(first.sharedArray(), second.sharedArray());
}

TEST(Value, EqualityComparesKindAndContent)
{
    EXPECT_EQ(Value(), Value());
    EXPECT_EQ(Value("a"), Value(std::string("a")));
    EXPECT_FALSE(Value("1") == Value(1));
    EXPECT_FALSE(Value(1) == Value(1.0));
    EXPECT_FALSE(Value(1) == Value(true));
    EXPECT_FALSE(Value() == Value(0));
    EXPECT_EQ(Value(makeData({std::byte{1}})), Value(makeData({std::byte{1}})));
    EXPECT_FALSE(Value(makeData({std::byte{1}})) == Value(makeData({std::byte{2}})));
    EXPECT_EQ(Value(makeArray({1, "b"})), Value(makeArray({1, "b"})));
    EXPECT_FALSE(Value(makeArray({1, "b"})) == Value(makeArray({"b", 1})));
    EXPECT_FALSE(Value(makeArray({1})) == Value(makeArray({1, 2})));
}

TEST(Value, EqualityOfDictionariesTakesAnyOrder)
{
    const Value ab = makeDictionary({{"a", 1}, {"b", makeArray({2})}});
    EXPECT_EQ(ab, Value(makeDictionary({{"b", makeArray({2})}, {"a", 1}})));
    EXPECT_FALSE(ab == Value(makeDictionary({{"a", 1}, {"b", makeArray({3})}})));
    EXPECT_FALSE(ab == Value(makeDictionary({{"a", 1}, {"c", makeArray({2})}})));
    EXPECT_FALSE(ab == Value(makeDictionary({{"a", 1}})));
}

TEST(Value, DeepCopySharesWhatDidNotChangeWithAnEarlierCopy)
{
    const Value shown = makeDictionary(
        {{"Cell", makeDictionary({{"PCI", "31"}, {"EARFCN", "1850"}})},
         {"Neighbours", makeArray({makeDictionary({{"PCI", "7"}}), makeDictionary({{"PCI", "8"}})})}});
    const auto part = [](const Value& copy, std::string_view name) { return *copy.dictionary()->find(name); };
    const Value first = deepCopySharing(shown, {});
    EXPECT_EQ(first, shown);
    EXPECT_NE(first.dictionary(), shown.dictionary());
    EXPECT_EQ(deepCopySharing(shown, first).dictionary(), first.dictionary());

    part(shown, "Neighbours").array()->elements[1].dictionary()->set("PCI", "9");
    const Value second = deepCopySharing(shown, first);
    EXPECT_EQ(second, shown);
    EXPECT_EQ(part(second, "Cell").dictionary(), part(first, "Cell").dictionary());
    EXPECT_EQ(part(second, "Neighbours").array()->elements[0].dictionary(),
              part(first, "Neighbours").array()->elements[0].dictionary());
    EXPECT_EQ(*part(first, "Neighbours").array()->elements[1].dictionary()->find("PCI"), Value("8"));

    part(shown, "Neighbours").array()->elements.pop_back();
    part(shown, "Cell").dictionary()->remove("PCI");
    const Value third = deepCopySharing(shown, second);
    EXPECT_EQ(third, shown);
    EXPECT_NE(part(third, "Cell").dictionary(), part(shown, "Cell").dictionary());
    EXPECT_NE(part(third, "Neighbours").array(), part(shown, "Neighbours").array());
}

TEST(Value, DeepCopyKeepsAnOrderThatTheEarlierCopyHasNot)
{
    const Value earlier = makeDictionary({{"a", "1"}, {"b", "2"}});
    const Value copy = deepCopySharing(makeDictionary({{"b", "2"}, {"a", "1"}}), earlier);
    EXPECT_EQ(copy.dictionary()->begin()->key.text(), "b");
}

TEST(Value, DeepCopySharesNoContainer)
{
    const auto inner = makeDictionary({{"Level", "-90"}});
    const auto list = makeArray({inner, 5});
    const Value original = makeDictionary({{"Cells", list}, {"Raw", makeData({std::byte{9}})}});
    const Value copy = deepCopy(original);
    EXPECT_EQ(copy, original);

    inner->set("Level", "-70");
    list->elements.emplace_back(6);
    original.dictionary()->set("New", 1);
    EXPECT_EQ(copy, Value(makeDictionary({{"Cells", makeArray({makeDictionary({{"Level", "-90"}}), 5})},
                                          {"Raw", makeData({std::byte{9}})}})));
    EXPECT_EQ(original.dictionary()->find("Raw")->data(), copy.dictionary()->find("Raw")->data());
}

TEST(Dictionary, KeepsTheOrderInWhichKeysWereFirstSet)
{
    Dictionary rows;
    rows.set("Zone", 1);
    rows.set(Label("Area"), 2);
    rows.set(Key(std::string("Mode")), 3);
    rows.set("Zone", 4);
    EXPECT_EQ(keysOf(rows), "Zone Area Mode ");
    EXPECT_EQ(rows.at("Zone"), Value(4));

    rows.remove("Zone");
    rows.remove("absent");
    rows.set("Zone", 5);
    EXPECT_EQ(keysOf(rows), "Area Mode Zone ");
    EXPECT_EQ(rows.size(), 3U);
    rows.clear();
    EXPECT_TRUE(rows.empty());
}

TEST(Dictionary, FindsAKeyWhateverItWasMadeOf)
{
    Dictionary rows;
    rows.set(Label("Band"), 1);
    rows.set(std::string_view("Level of the cell that serves"), 2);
    EXPECT_EQ(rows.at(std::string("Band")), Value(1));
    EXPECT_EQ(*rows.find("Level of the cell that serves"), Value(2));
    EXPECT_EQ(rows.find("band"), nullptr);
    EXPECT_EQ(rows.find("Ban"), nullptr);
    EXPECT_FALSE(rows.at("Bands"));
    *rows.find("Band") = "changed";
    EXPECT_EQ(rows.at("Band"), Value("changed"));
}

TEST(Dictionary, KeysOutliveTheTextTheyWereMadeOf)
{
    Dictionary rows;
    {
        std::string name = "a name that is too long for the string's own buffer";
        rows.set(name, 1);
        name.assign(name.size(), 'x');
    }
    const Dictionary copy = rows;
    rows.clear();
    EXPECT_EQ(keysOf(copy), "a name that is too long for the string's own buffer ");
}

TEST(Dictionary, SlotAddsANilAndReturnsThePresentValueAfterwards)
{
    Dictionary rows;
    EXPECT_FALSE(rows.slot("Row"));
    rows.slot("Row") = "shown";
    EXPECT_EQ(rows.slot("Row"), Value("shown"));
    EXPECT_EQ(rows.size(), 1U);
}

TEST(Dictionary, SlotHintsSurviveRowsThatGo)
{
    Dictionary rows;
    std::size_t a = 0;
    std::size_t b = 0;
    std::size_t c = 0;
    rows.slot("A", a) = 1;
    rows.slot("B", b) = 2;
    rows.slot("C", c) = 3;
    EXPECT_EQ(c, 2U);

    rows.remove("A");
    rows.slot("C", c) = 30; // the hint is beyond the end now
    EXPECT_EQ(c, 1U);
    rows.slot("B", b) = 20; // the hint is another row's place now
    EXPECT_EQ(b, 0U);
    rows.slot("A", a) = 10; // gone, comes back at the end
    EXPECT_EQ(keysOf(rows), "B C A ");
    EXPECT_EQ(rows.at("A"), Value(10));
    EXPECT_EQ(rows.at("B"), Value(20));
    EXPECT_EQ(rows.at("C"), Value(30));

    rows.clear();
    rows.slot("B", b) = 200;
    EXPECT_EQ(rows.at("B"), Value(200));
    EXPECT_EQ(rows.size(), 1U);
}

TEST(Signed32, ReadsIntegersAndKeepsTheLow32Bits)
{
    const auto read = [](std::int64_t number) {
        const Value value(number);
        return signed32(&value);
    };
    EXPECT_EQ(read(0), 0);
    EXPECT_EQ(read(-5), -5);
    EXPECT_EQ(read(2147483647), 2147483647);
    EXPECT_EQ(read(2147483648), -2147483648LL);
    EXPECT_EQ(read(4294967295), -1);
    EXPECT_EQ(read(0x1'2345'6789'ABCDLL), 0x6789ABCD);
    EXPECT_EQ(read(std::numeric_limits<std::int64_t>::min()), 0);
    EXPECT_EQ(read(std::numeric_limits<std::int64_t>::max()), -1);
}

TEST(Signed32, ReadsStringsOfDigits)
{
    const auto read = [](const char* text) {
        const Value value(text);
        return signed32(&value);
    };
    EXPECT_EQ(read("0"), 0);
    EXPECT_EQ(read("262"), 262);
    EXPECT_EQ(read("007"), 7);
    EXPECT_EQ(read("-105"), -105);
    EXPECT_EQ(read("+12"), 12);
    EXPECT_EQ(read("2147483648"), -2147483648LL);
    EXPECT_EQ(read("4294967297"), 1);
    EXPECT_EQ(read("-4294967297"), -1);
    EXPECT_EQ(read("18446744073709551617"), 1);
    for (const char* text : {"", "+", "-", "12a", " 12", "12 ", "+-1", "1.5", "0x10"})
        EXPECT_EQ(read(text), std::nullopt) << '"' << text << '"';
}

TEST(Signed32, ReadsNothingElse)
{
    EXPECT_EQ(signed32(nullptr), std::nullopt);
    for (const Value& value : {Value(), Value(1.0), Value(true), Value(makeArray({1})),
                               Value(makeDictionary()), Value(makeData({std::byte{'1'}})), Value(Date())})
        EXPECT_EQ(signed32(&value), std::nullopt);
}

} // namespace
} // namespace pelorus
