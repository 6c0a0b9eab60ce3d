#include "platform/PropertyList.h"
#include "tests/platform/PropertyListText.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace pelorus {
namespace {

using namespace std::literals;

std::string inHeader(std::string_view root)
{
    return std::string(kXmlHeader) + std::string(root) + "\n</plist>\n";
}

std::string nested(std::size_t containers)
{
    std::string text;
    for (std::size_t i = 0; i < containers; ++i)
        text += "<array>";
    for (std::size_t i = 0; i < containers; ++i)
        text += "</array>";
    return text;
}

TEST(XmlPropertyList, ReadsEveryKind)
{
    const Value list =
        parsed(inHeader("<dict>\n"
                        "\t<key>Text</key>\n\t<string>Zürich</string>\n"
                        "\t<key>Number</key>\n\t<integer>-42</integer>\n"
                        "\t<key>Hex</key>\n\t<integer>0xFF</integer>\n"
                        "\t<key>Real</key>\n\t<real>-1.5e3</real>\n"
                        "\t<key>Yes</key>\n\t<true/>\n"
                        "\t<key>No</key>\n\t<false></false>\n"
                        "\t<key>Date</key>\n\t<date>2012-05-04T09:30:00Z</date>\n"
                        "\t<key>Data</key>\n\t<data>\n\tAQID\n\t/w==\n\t</data>\n"
                        "\t<key>List</key>\n\t<array>\n\t\t<string>a</string>\n\t\t<array/>\n\t</array>\n"
                        "</dict>"));
    ASSERT_TRUE(list.dictionary());
    const Dictionary& dictionary = *list.dictionary();
    EXPECT_EQ(dictionary.at("Text"), Value("Z\xC3\xBCrich"));
    EXPECT_EQ(dictionary.at("Number"), Value(-42));
    EXPECT_EQ(dictionary.at("Hex"), Value(255));
    EXPECT_EQ(dictionary.at("Real"), Value(-1500.0));
    EXPECT_EQ(dictionary.at("Yes"), Value(true));
    EXPECT_EQ(dictionary.at("No"), Value(false));
    EXPECT_EQ(dictionary.at("Date"), Value(dateAt(1336123800)));
    EXPECT_EQ(dictionary.at("Data"),
              Value(makeData({std::byte{1}, std::byte{2}, std::byte{3}, std::byte{255}})));
    EXPECT_EQ(dictionary.at("List"), Value(makeArray({"a", makeArray()})));
    std::string keys;
    for (const auto& entry : dictionary)
        keys += std::string(entry.key.text()) + " ";
    EXPECT_EQ(keys, "Text Number Hex Real Yes No Date Data List ");
}

TEST(XmlPropertyList, ReadsListsWithAndWithoutTheirUsualSurroundings)
{
    const Value expected = makeArray({"x"});
    for (const std::string& text : {
             inHeader("<array><string>x</string></array>"),
             "<plist><array><string>x</string></array></plist>"s,
             "<plist version='1.0' ><array ><string >x</string ></array ></plist >"s,
             "<array><string>x</string></array>"s,
             "\n\t <array><string>x</string></array> \r\n"s,
             "\xEF\xBB\xBF<?xml version='1.0' encoding='utf-8'?><array><string>x</string></array>"s,
             "<!-- <dict> --><!DOCTYPE plist SYSTEM \"a>[b\"><?other <dict> ?><array><!-- <array> -->"
             "<string>x</string><!----></array><!-- > -->"s,
             "<plist version=\"1.0\"><array><string>x</string></array><!-- --></plist>\n<!-- end -->\n"s,
             "<plist><array><string>x</string></array></plist>\n\0\0"s,
             "<array><string>x</string></array>\0"s,
         })
        EXPECT_EQ(parsed(text), expected) << text;
}

TEST(XmlPropertyList, ReadsASingleValueAndEmptyOnes)
{
    EXPECT_EQ(parsed("<string>only</string>"), Value("only"));
    EXPECT_EQ(parsed("<plist><integer> 7 </integer></plist>\0"sv), Value(7));
    EXPECT_EQ(parsed("<plist><true/></plist>"), Value(true));
    EXPECT_EQ(parsed(inHeader("<array/>") + '\0'), Value(makeArray()));
    EXPECT_EQ(parsed(inHeader("<dict></dict>")), Value(makeDictionary()));
    EXPECT_EQ(parsed("<dict />"), Value(makeDictionary()));
    EXPECT_EQ(parsed("<array><string/><string></string><data/><data> </data><dict/></array>"),
              Value(makeArray({"", "", makeData({}), makeData({}), makeDictionary()})));
    EXPECT_EQ(parsed("<dict><key></key><string>of the empty key</string></dict>"),
              Value(makeDictionary({{"", "of the empty key"}})));
}

TEST(XmlPropertyList, ReadsTextWithEntitiesCommentsAndCdata)
{
    const auto read = [](const std::string& text) { return parsed("<string>" + text + "</string>"); };
    EXPECT_EQ(read("a&amp;b&lt;&gt;&quot;&apos;"), Value("a&b<>\"'"));
    EXPECT_EQ(read("&#x41;&#66;&#xe9;&#x20AC;&#x1F600;&#x10FFFF;"),
              Value("AB\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80\xF4\x8F\xBF\xBF"));
    EXPECT_EQ(read("&amp;amp;"), Value("&amp;"));
    EXPECT_EQ(read(" one <!-- & no entity --> two "), Value(" one  two "));
    EXPECT_EQ(read("a<![CDATA[<b> & ]] &amp;]]>c"), Value("a<b> & ]] &amp;c"));
    EXPECT_EQ(read("<![CDATA[]]><!---->"), Value(""));
    EXPECT_EQ(read("line\n\ttab "), Value("line\n\ttab "));
    EXPECT_EQ(parsed("<dict><key>A&amp;B</key><true/></dict>"), Value(makeDictionary({{"A&B", true}})));
}

TEST(XmlPropertyList, ReadsTheWholeRangeOfNumbersAndDates)
{
    const auto read = [](const std::string& root) { return parsed(root); };
    EXPECT_EQ(read("<integer>0</integer>"), Value(0));
    EXPECT_EQ(read("<integer>+12</integer>"), Value(12));
    EXPECT_EQ(read("<integer>-0x10</integer>"), Value(-16));
    EXPECT_EQ(read("<integer>-9223372036854775808</integer>"),
              Value(std::numeric_limits<std::int64_t>::min()));
    EXPECT_EQ(read("<integer>9223372036854775807</integer>"),
              Value(std::numeric_limits<std::int64_t>::max()));
    EXPECT_EQ(read("<integer>18446744073709551615</integer>"), Value(-1));
    EXPECT_EQ(read("<real>+infinity</real>"), Value(std::numeric_limits<double>::infinity()));
    EXPECT_TRUE(std::isnan(*read("<real>nan</real>").real()));
    EXPECT_EQ(read("<real>5</real>"), Value(5.0));
    EXPECT_EQ(read("<date>2001-01-01T00:00:00Z</date>"), Value(dateAt(978307200)));
    EXPECT_EQ(read("<date>2000-12-31T23:59:59Z</date>"), Value(dateAt(978307199)));
    EXPECT_EQ(read("<date>1970-01-01T00:00:00Z</date>"), Value(dateAt(0)));
    EXPECT_EQ(read("<date>4001-01-01T00:00:00Z</date>"), Value(dateAt(64092211200)));
    EXPECT_EQ(read("<date>0001-01-01T00:00:00Z</date>"), Value(dateAt(-62135596800)));
    EXPECT_EQ(read("<date> 9999-12-31T23:59:59Z\n</date>"), Value(dateAt(253402300799)));
}

TEST(XmlPropertyList, KeepsAKeysFirstPlaceAndLastValue)
{
    const Value list = parsed("<dict><key>a</key><integer>1</integer><key>b</key><integer>2</integer>"
                              "<key>a</key><integer>3</integer></dict>");
    ASSERT_TRUE(list.dictionary());
    EXPECT_EQ(list.dictionary()->size(), 2U);
    EXPECT_EQ(list.dictionary()->begin()->key.text(), "a");
    EXPECT_EQ(list.dictionary()->begin()->value, Value(3));
}

TEST(XmlPropertyList, SaysWhereACutListEnds)
{
    EXPECT_EQ(refusal(""), "the property list is empty");
    EXPECT_EQ(refusal(kXmlHeader), "the XML property list ends before its value does");
    EXPECT_EQ(refusal("<plist><array><string>x</string>"), "the XML property list ends inside <array>");
    EXPECT_EQ(refusal("<plist><array><string>x"), "the XML property list ends inside <string>");
    EXPECT_EQ(refusal("<dict><key>k</key><array/>"), "the XML property list ends inside <dict>");
    EXPECT_EQ(refusal("<dict><key>k</ke"), "the XML property list ends inside <key>");
    EXPECT_EQ(refusal("<plist><array/>"), "the XML property list ends inside <plist>");
    EXPECT_EQ(refusal("<array><!-- "), "the XML property list ends inside <array>");
    EXPECT_EQ(refusal("<array/"), "the XML property list ends before its value does");
}

TEST(XmlPropertyList, RefusesWhatIsNoPropertyList)
{
    EXPECT_EQ(refusal("hello"), "the bytes are no property list");
    EXPECT_EQ(refusal("{ a = b; }"), "the bytes are no property list");
    EXPECT_EQ(refusal("bplist"), "the bytes are no property list");
    EXPECT_EQ(refusal("bplist15 and more"), "the bytes are no property list");
    EXPECT_EQ(refusal("\0\0\0\0"sv), "the bytes are no property list");
    EXPECT_EQ(refusal("<html></html>"), "the XML property list has an unknown element <html>");
    EXPECT_EQ(refusal("<array>x</array>"), "the XML property list has text between the elements of <array>");
    EXPECT_EQ(refusal("<array><dict></array></dict>"),
              "the XML property list has </array> where <dict> ends");
    EXPECT_EQ(refusal("</array>"), "the XML property list has </array> where nothing ends");
    EXPECT_EQ(refusal("<string>a</strin>"), "the XML property list has </strin> where <string> ends");
    EXPECT_EQ(refusal("<string>a<b/></string>"), "the XML property list has <b> inside <string>");
    EXPECT_EQ(refusal("<array/><array/>"), "something follows the XML property list");
    EXPECT_EQ(refusal("<plist><array/><array/></plist>"), "the XML property list holds more than one value");
    EXPECT_EQ(refusal("<plist></plist>"), "the XML property list has </plist> where nothing ends");
    EXPECT_EQ(refusal("<plist/>"), "the XML property list has a malformed <plist>");
    EXPECT_EQ(refusal("<dict><string>a</string></dict>"),
              "the XML property list has <string> in the place of a key");
    EXPECT_EQ(refusal("<dict><key>a</key><key>b</key></dict>"),
              "the XML property list has <key> in the place of a value");
    EXPECT_EQ(refusal("<array><key>a</key></array>"),
              "the XML property list has <key> in the place of a value");
    EXPECT_EQ(refusal("<dict><key>a</key></dict>"), "the XML property list has a <key> without a value");
    EXPECT_EQ(refusal("<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?><array/>"),
              "the XML property list is not in UTF-8");
    EXPECT_EQ(refusal("<!DOCTYPE plist [<!ENTITY a \"b\">]><string>&a;</string>"),
              "the XML property list has document type declarations of its own");
    EXPECT_EQ(refusal("<string>a\0b</string>"sv), "the XML property list holds a NUL");
    EXPECT_EQ(refusal("<dict><key/><true/></dict>"), "the XML property list has an empty <key/>");
}

TEST(XmlPropertyList, RefusesWhatLibplistWouldTakeForSomethingElse)
{
    for (const char* text : {"<integer></integer>",
                             "<integer/>",
                             "<integer>12a</integer>",
                             "<integer>010</integer>",
                             "<integer>--1</integer>",
                             "<integer>1 2</integer>",
                             "<integer>18446744073709551616</integer>",
                             "<integer>-9223372036854775809</integer>",
                             "<integer>1<!-- -->2</integer>",
                             "<integer>&#49;</integer>",
                             "<real>1,5</real>",
                             "<real>x</real>",
                             "<real/>",
                             "<date>2012-05-04</date>",
                             "<date>2012-13-04T09:30:00Z</date>",
                             "<date>12012-05-04T09:30:00Z</date>",
                             "<date/>",
                             "<data>AQI</data>",
                             "<data>A*==</data>",
                             "<data>AQ==AQ==</data>",
                             "<data>AQ<!-- -->==</data>",
                             "<true>x</true>",
                             "<string>a & b</string>",
                             "<string>&ampx;</string>",
                             "<string>&nbsp;</string>",
                             "<string>&#0;</string>",
                             "<string>&#x110000;</string>",
                             "<string>&#xD800;</string>",
                             "<string>&#-5;</string>",
                             "<string>&</string>",
                             "<string>&amp</string>",
                             "<string><![cdata[a]]></string>",
                             "<string><?a?></string>",
                             "<array key=\"a/\"></array>",
                             "<array a></array>",
                             "<Array/>",
                             "< array/>",
                             "<array / >",
                             "<array/></array>",
                             "<array><?a?></array>",
                             "<array></array/>"})
        EXPECT_NE(refusal(text), "") << text;
}

TEST(XmlPropertyList, ReadsToTheDepthLimitAndNoFurther)
{
    EXPECT_TRUE(parsed(nested(256)).array());
    EXPECT_EQ(refusal(nested(257)), "the property list nests deeper than 256 containers");
}

class BothForms : public testing::TestWithParam<PropertyListForm> {
protected:
    Value roundTrip(const Value& value) const { return parsed(serialized(value, GetParam())); }
};
INSTANTIATE_TEST_SUITE_P(PropertyList, BothForms,
                         testing::Values(PropertyListForm::xml, PropertyListForm::binary),
                         [](const auto& form) {
                             return form.param == PropertyListForm::xml ? "xml" : "binary";
                         });

TEST_P(BothForms, KeepIntegers)
{
    for (const std::int64_t number :
         {std::int64_t{0}, std::int64_t{1}, std::int64_t{-1}, std::int64_t{-5}, std::int64_t{255},
          std::int64_t{256}, std::int64_t{65536}, std::int64_t{-2147483649}, std::int64_t{4294967296},
          std::numeric_limits<std::int64_t>::min(), std::numeric_limits<std::int64_t>::max()}) {
        EXPECT_EQ(roundTrip(number), Value(number)) << number;
        EXPECT_EQ(roundTrip(makeDictionary({{"n", number}})), Value(makeDictionary({{"n", number}})))
            << number;
    }
}

TEST_P(BothForms, KeepReals)
{
    for (const double number : {0.0, 0.1, -90.25, 1.0 / 3, 1e-300, -1e300, 5e-324, 123456789.123456789,
                                std::numeric_limits<double>::max(), -std::numeric_limits<double>::infinity()})
        EXPECT_EQ(roundTrip(number), Value(number)) << number;
    EXPECT_TRUE(std::isnan(*roundTrip(std::nan("")).real()));
}

TEST_P(BothForms, KeepDates)
{
    for (const std::int64_t seconds :
         {std::int64_t{978307200}, std::int64_t{978307199}, std::int64_t{1336123800}, std::int64_t{0},
          std::int64_t{-1}, std::int64_t{3125790847}, std::int64_t{3125790848}, std::int64_t{-1169176448},
          std::int64_t{-1169176449}, std::int64_t{64092211200}, std::int64_t{-62135596800},
          std::int64_t{-62167219200}, std::int64_t{253402300799}})
        EXPECT_EQ(roundTrip(dateAt(seconds)), Value(dateAt(seconds))) << seconds;
    EXPECT_EQ(serialized(dateAt(-62167219201), GetParam()), "");
    EXPECT_EQ(serialized(dateAt(253402300800), GetParam()), "");
    EXPECT_EQ(serialized(Date::max(), GetParam()), "");
    EXPECT_EQ(serialized(Date::min(), GetParam()), "");
}

TEST_P(BothForms, KeepStrings)
{
    std::string controls;
    for (char c = 1; c < 32; ++c)
        controls += c;
    for (const std::string& text :
         {""s, "a"s, "<>&\"'"s, "]]>"s, "&amp;"s, " blanks "s, "\x01\n\t"s, "\r\n"s, controls, "\x7F"s,
          "Z\xC3\xBCrich \xE2\x82\xAC"s, "\xF0\x9F\x98\x80"s, "\xEF\xBF\xBF"s, std::string(100000, 'x'),
          std::string(5000, '<'), "-5"s}) {
        EXPECT_EQ(roundTrip(text), Value(text));
        EXPECT_EQ(roundTrip(makeDictionary({{text, text}})), Value(makeDictionary({{text, text}})));
    }
}

TEST_P(BothForms, WriteWhatNoListCanHoldAsReplacementCharacters)
{
    EXPECT_EQ(roundTrip("a\0b"s), Value("a\xEF\xBF\xBD"
                                        "b"));
    EXPECT_EQ(roundTrip("\xFF\xFE"), Value("\xEF\xBF\xBD\xEF\xBF\xBD"));
    EXPECT_EQ(roundTrip("caf\xE9"), Value("caf\xEF\xBF\xBD"));
    EXPECT_EQ(roundTrip("\xC0\xAF|"), Value("\xEF\xBF\xBD\xEF\xBF\xBD|"));
    EXPECT_EQ(roundTrip("\xED\xA0\x80"), Value("\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD"));
    EXPECT_EQ(roundTrip("\xF4\x90\x80\x80"), Value("\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD"));
}

TEST_P(BothForms, KeepData)
{
    for (const std::size_t size : {0U, 1U, 2U, 3U, 4U, 14U, 15U, 255U, 256U, 1'000'000U}) {
        std::vector<std::byte> bytes(size);
        for (std::size_t i = 0; i < size; ++i)
            bytes[i] = static_cast<std::byte>(i * 7);
        const Value value = makeData(bytes);
        EXPECT_EQ(roundTrip(value), value) << size;
        EXPECT_EQ(roundTrip(makeArray({makeArray({value})})), Value(makeArray({makeArray({value})}))) << size;
    }
}

TEST_P(BothForms, KeepContainersAndTheirOrder)
{
    const Value value = makeArray(
        {makeArray(), makeDictionary(), true, false, 1, 1.0, "1", "1",
         makeDictionary(
             {{"z", 1}, {"a", makeArray({makeDictionary({{"z", "shared text"}}), "shared text"})}})});
    const Value back = roundTrip(value);
    EXPECT_EQ(back, value);
    ASSERT_TRUE(back.array());
    EXPECT_EQ(back.array()->elements.back().dictionary()->begin()->key.text(), "z");
}

TEST_P(BothForms, ReachTheDepthLimitAndNoFurther)
{
    Value value = makeArray({1});
    for (int depth = 1; depth < 256; ++depth)
        value = depth % 2 ? Value(makeArray({value})) : Value(makeDictionary({{"k", value}}));
    EXPECT_EQ(roundTrip(value), value);
    EXPECT_EQ(serialized(makeArray({value}), GetParam()), "");

    const auto loop = makeArray();
    loop->elements.emplace_back(loop);
    EXPECT_EQ(serialized(loop, GetParam()), "");
    loop->elements.clear();
}

TEST_P(BothForms, WriteNothingWithANilInside)
{
    EXPECT_EQ(serializePropertyList(Value(), GetParam()), std::nullopt);
    EXPECT_EQ(serializePropertyList(makeArray({1, Value()}), GetParam()), std::nullopt);
    EXPECT_EQ(serializePropertyList(makeDictionary({{"a", makeArray({makeDictionary({{"b", Value()}})})}}),
                                    GetParam()),
              std::nullopt);
}

TEST_P(BothForms, CarryALargeDictionary)
{
    const auto dictionary = makeDictionary();
    dictionary->reserve(10'000);
    for (int i = 0; i < 10'000; ++i)
        dictionary->append(Key("key number " + std::to_string(i)), i);
    const Value back = roundTrip(dictionary);
    ASSERT_TRUE(back.dictionary());
    ASSERT_EQ(back.dictionary()->size(), 10'000U);
    int i = 0;
    for (const auto& entry : *back.dictionary()) {
        ASSERT_EQ(entry.key.text(), "key number " + std::to_string(i));
        ASSERT_EQ(entry.value, Value(i++));
    }
}

TEST(XmlPropertyList, IsWrittenToTheUsualForm)
{
    const std::string header = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<!DOCTYPE plist PUBLIC ";
    const std::string empty = serialized(makeDictionary(), PropertyListForm::xml);
    EXPECT_EQ(empty.substr(0, header.size()), header);
    const std::size_t prologue = empty.find("<plist ");
    EXPECT_EQ(serialized(makeDictionary({{"GetTechnology", "Get<&>\"Technology\""},
                                         {"n", -5},
                                         {"big", std::numeric_limits<std::int64_t>::max()},
                                         {"r", 0.5},
                                         {"l", makeArray({true, makeData({std::byte{0xFF}}),
                                                          dateAt(1336123800, 999'999)})}}),
                         PropertyListForm::xml)
                  .substr(prologue),
              "<plist version=\"1.0\">\n"
              "<dict>\n"
              "\t<key>GetTechnology</key>\n"
              "\t<string>Get&lt;&amp;&gt;\"Technology\"</string>\n"
              "\t<key>n</key>\n"
              "\t<integer>-5</integer>\n"
              "\t<key>big</key>\n"
              "\t<integer>9223372036854775807</integer>\n"
              "\t<key>r</key>\n"
              "\t<real>0.5</real>\n"
              "\t<key>l</key>\n"
              "\t<array>\n"
              "\t\t<true/>\n"
              "\t\t<data>\n"
              "\t\t/w==\n"
              "\t\t</data>\n"
              "\t\t<date>2012-05-04T09:30:00Z</date>\n"
              "\t</array>\n"
              "</dict>\n"
              "</plist>\n");
    EXPECT_EQ(parsed(serialized(dateAt(-2, 250'000), PropertyListForm::xml)), Value(dateAt(-2)));
}

} // namespace
} // namespace pelorus
