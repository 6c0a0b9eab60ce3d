#include "tests/platform/BinaryListBuilder.h"
#include "tests/platform/PropertyListText.h"

#include <gtest/gtest.h>

#include <array>
#include <random>

// Lists that are made to crash, to fill the memory or to take forever. That these tests end, and within
// seconds, is most of what they test.

namespace pelorus {
namespace {

using namespace std::literals;

constexpr std::size_t kMany = 16 * 1024 * 1024;

std::string repeated(std::string_view text, std::size_t times)
{
    std::string all;
    all.reserve(text.size() * times);
    for (std::size_t i = 0; i < times; ++i)
        all += text;
    return all;
}

/// Fills 16 MiB with the text between a start and an end.
std::string filled(std::string_view start, std::string_view text, std::string_view end)
{
    return std::string(start) + repeated(text, (kMany - start.size() - end.size()) / text.size()) +
           std::string(end);
}

std::string honestXml()
{
    return std::string(kXmlHeader) +
           "<dict>\n<!-- c --><key>A&amp;B</key><array><integer>-1</integer><real>2.5</real><true/>"
           "<date>2012-05-04T09:30:00Z</date><data>AQI=</data><string><![CDATA[x]]>y</string></array>"
           "<key>C</key><dict/></dict>\n</plist>";
}

std::string honestBinary()
{
    return BinaryListBuilder()
        .dictionary({1, 2}, {3, 4})
        .string("A key of more than fifteen")
        .object("\x62\0C\0\xE9"sv)
        .array({4, 5, 6, 7, 8})
        .object("\x13\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFB")
        .object("\x23\x3F\xB9\x99\x99\x99\x99\x99\x9A")
        .object("\x33\x41\xB5\x53\xE5\x98\0\0\0"sv)
        .object("\x43\1\2\3")
        .dictionary({1}, {5})
        .bytes();
}

TEST(HostilePropertyList, NestedXml)
{
    for (const std::size_t depth : {std::size_t{257}, std::size_t{100'000}, std::size_t{1'000'000}}) {
        for (const auto& [start, end] :
             {std::pair{"<array>", "</array>"}, std::pair{"<dict><key>k</key>", "</dict>"},
              std::pair{"<array><true/>", "</array>"}}) {
            EXPECT_EQ(refusal(repeated(start, depth)), "the property list nests deeper than 256 containers");
            EXPECT_NE(refusal(repeated(start, depth) + "<true/>" + repeated(end, depth)), "");
            EXPECT_NE(refusal(std::string(kXmlHeader) + repeated(start, depth)), "");
        }
        EXPECT_NE(refusal(repeated("<plist>", depth)), "");
        EXPECT_NE(refusal(repeated("</array>", depth)), "");
    }
}

TEST(HostilePropertyList, NestedBinary)
{
    for (const std::uint64_t depth : {std::uint64_t{257}, std::uint64_t{100'000}, std::uint64_t{1'000'000}}) {
        BinaryListBuilder list;
        list.referenceSize = 3;
        for (std::uint64_t i = 0; i < depth; ++i)
            list.array({i + 1});
        list.object("\x09");
        EXPECT_EQ(refusal(list.bytes()), "the property list nests deeper than 256 containers");
    }
}

TEST(HostilePropertyList, BinaryDepthLimitIsThatOfXml)
{
    BinaryListBuilder list;
    list.referenceSize = 2;
    for (std::uint64_t i = 0; i < 256; ++i)
        list.array({i + 1});
    EXPECT_TRUE(parsed(list.object("\x09").bytes()).array());
}

TEST(HostilePropertyList, Cycles)
{
    EXPECT_NE(refusal(BinaryListBuilder().array({0}).bytes()), "");
    EXPECT_NE(refusal(BinaryListBuilder().array({0, 0, 0}).bytes()), "");
    EXPECT_NE(refusal(BinaryListBuilder().array({1}).array({0}).bytes()), "");
    EXPECT_NE(refusal(BinaryListBuilder().dictionary({1}, {0}).string("k").bytes()), "");
}

TEST(HostilePropertyList, SharedReferencesThatExpand)
{
    for (const std::uint64_t levels : {20U, 30U, 60U, 100U, 250U}) {
        BinaryListBuilder list;
        for (std::uint64_t i = 0; i < levels; ++i)
            list.array({i + 1, i + 1});
        EXPECT_EQ(refusal(list.object("\x09").bytes()), "the property list holds more than 250000 values");
        BinaryListBuilder empty; // nothing but containers
        for (std::uint64_t i = 0; i < levels; ++i)
            empty.array({i + 1, i + 1});
        EXPECT_EQ(refusal(empty.array({}).bytes()), "the property list holds more than 250000 values");
    }
    BinaryListBuilder data;
    data.referenceSize = 2;
    data.array(std::vector<std::uint64_t>(10'000, 1)).string(std::string(10'000, 'x'));
    EXPECT_EQ(refusal(data.bytes()),
              "the property list expands by more than 67108864 bytes of text and data");
    BinaryListBuilder keys;
    keys.array(std::vector<std::uint64_t>(20'000, 1)).dictionary({2}, {3}).string(std::string(10'000, 'x'));
    EXPECT_NE(refusal(keys.object("\x09").bytes()), "");
}

/// Fifty dictionaries in one another under keys of 10,000 bytes each, in the last an array of so many
/// elements.
std::string binaryWithLongPaths(std::size_t elements)
{
    BinaryListBuilder list;
    for (std::uint64_t level = 0; level < 50; ++level)
        list.dictionary({50}, {level == 49 ? 51 : level + 1});
    return list.string(std::string(10'000, 'k'))
        .array(std::vector<std::uint64_t>(elements, 52))
        .object("\x09")
        .bytes();
}

std::string xmlWithLongPaths(std::size_t elements)
{
    return repeated("<dict><key>" + std::string(10'000, 'k') + "</key>", 50) + "<array>" +
           repeated("<true/>", elements) + "</array>" + repeated("</dict>", 50);
}

// Who shows such a list would hold each element's whole path: of these, half a megabyte each.
TEST(HostilePropertyList, ManyLongPaths)
{
    for (const auto& list : {binaryWithLongPaths, xmlWithLongPaths}) {
        EXPECT_EQ(refusal(list(280)), "the property list has more than 134217728 bytes of paths");
        EXPECT_EQ(refusal(list(240)), "");
    }
}

TEST(HostilePropertyList, ALongRawLogIsNoExpansion)
{
    const Value log = makeData(std::vector<std::byte>(70 * 1024 * 1024, std::byte{0x5A}));
    for (const PropertyListForm form : {PropertyListForm::xml, PropertyListForm::binary})
        EXPECT_TRUE(parsePropertyList(serializePropertyList(log, form).value()) == log);
}

TEST(HostilePropertyList, ValuesToTheLimit)
{
    BinaryListBuilder list;
    list.array(std::vector<std::uint64_t>(249'999, 1))
        .object("\x33\x41\xB5\x53\xE5\x98\x10\0\0"sv); // a fraction
    const Value most = parsed(list.bytes());
    ASSERT_TRUE(most.array());
    EXPECT_EQ(most.array()->elements.size(), 249'999U);
    BinaryListBuilder more;
    more.array(std::vector<std::uint64_t>(250'000, 1)).object("\x09");
    EXPECT_EQ(refusal(more.bytes()), "the property list holds more than 250000 values");

    const std::string xml = "<array>" + repeated("<true/>", 249'999);
    EXPECT_EQ(parsed(xml + "</array>").array()->elements.size(), 249'999U);
    EXPECT_EQ(refusal(xml + "<true/></array>"), "the property list holds more than 250000 values");
}

TEST(HostilePropertyList, SixteenMegabytesOfAnything)
{
    const auto manyOf = [](std::string_view element) {
        return "<array>" + repeated(element, 1'000) + "</array>";
    };
    const auto check = [](const std::string& list) {
        std::string why;
        const Value value = parsed(list, &why);
        EXPECT_EQ(!value, !why.empty()) << list.substr(0, 60);
        EXPECT_LT(why.size(), 200U) << list.substr(0, 60);
        EXPECT_EQ(why.find('\n'), std::string::npos);
    };
    check(std::string(kMany, '\0'));
    check(std::string(kMany, ' '));
    check(std::string(kMany, '<'));
    check(std::string(kMany, '"'));
    check(std::string(kMany, 'a'));
    check(filled("<", "a", ""));
    check(filled("<string>", "&", "</string>"));
    check(filled("<string>", "&lt;", "</string>"));
    check(filled("<array>", manyOf("<string>&lt;</string>"), "</array>"));
    check(filled("<string>", "<!---->", "</string>"));
    check(filled("<string>", "<![CDATA[", "</string>"));
    check(filled("<string>", "<![CDATA[x]]>", "</string>"));
    check(filled("<array>", "<!-- -->", "</array>"));
    check(filled("<array>", "<!--", "</array>"));
    check(filled("", "<?a?>", "<array/>"));
    check(filled("<?xml ", "\"", "?><array/>"));
    check(filled("<!DOCTYPE ", "\"", "><array/>"));
    check(filled("<!DOCTYPE ", "[", "><array/>"));
    check(filled("<integer>", "1", "</integer>"));
    check(filled("<real>", "1", "</real>"));
    check(filled("<date>", "1", "</date>"));
    check(filled("<data>", "A", "</data>"));
    check(filled("<data>", "A B", "</data>"));
    check(filled("<array>", "<data>AAAA</data>", "</array>"));
    check(filled("<dict>", "<key>k</key><true/>", "</dict>"));
    check(filled("<array>", manyOf("<dict><key>k</key><true/></dict>"), "</array>"));
    check(filled("bplist00", "\xA1", std::string(32, '\1')));
    check(filled("bplist00", "\0"sv, std::string(6, '\0') + "\1\1" + std::string(24, '\0')));
}

TEST(HostilePropertyList, LongHonestTextsAreRead)
{
    const std::string text(kMany, 'x');
    EXPECT_EQ(parsed("<string>" + text + "</string>"), Value(text));
    BinaryListBuilder list;
    EXPECT_EQ(parsed(list.string(text).bytes()), Value(text));
}

/// Keys that all have the same hash in libplist, whose look-up then compares each with all before it.
TEST(HostilePropertyList, CollidingKeys)
{
    const auto key = [](unsigned number, std::size_t padding) {
        std::string text(padding, 'p');
        for (unsigned bit = 0; bit < 20; ++bit)
            text += number >> bit & 1 ? "ab" : "bA";
        return text;
    };
    for (const auto& [count, padding] :
         {std::pair{10'000U, 0U}, std::pair{100'000U, 0U}, std::pair{10'000U, 1'500U}}) {
        std::string xml = "<dict>";
        for (unsigned i = 0; i < count; ++i)
            xml += "<key>" + key(i, padding) + "</key><true/>";
        const std::string why = refusal(xml + "</dict>");
        if (count == 100'000) {
            EXPECT_EQ(why,
                      "the XML property list has too many keys in one dictionary or entities in one text");
        }

        BinaryListBuilder list;
        list.referenceSize = 3;
        std::vector<std::uint64_t> keys(count);
        for (unsigned i = 0; i < count; ++i) {
            list.string(key(i, padding));
            keys[i] = i;
        }
        list.root = count;
        list.dictionary(keys, std::vector<std::uint64_t>(count, count + 1)).object("\x09");
        const Value back = parsed(list.bytes());
        ASSERT_TRUE(back.dictionary());
        EXPECT_EQ(back.dictionary()->size(), count);
    }
}

TEST(HostilePropertyList, EveryPrefixOfAnHonestList)
{
    for (const std::string& list : {honestXml(), honestBinary()}) {
        ASSERT_EQ(refusal(list), "");
        for (std::size_t length = 0; length < list.size(); ++length) {
            // A buffer of its own, so that a read beyond its end is seen by the sanitizer.
            const std::string prefix(list.data(), length);
            EXPECT_NE(
                refusal(std::string_view(std::vector<char>(prefix.begin(), prefix.end()).data(), length)), "")
                << length;
        }
    }
}

TEST(HostilePropertyList, EveryByteOfAnHonestListChanged)
{
    for (const std::string& list : {honestXml(), honestBinary()})
        for (std::size_t place = 0; place < list.size(); ++place)
            for (int byte = 0; byte < 256; ++byte) {
                std::vector<char> changed(list.begin(), list.end());
                changed[place] = static_cast<char>(byte);
                std::string why;
                const Value value = parsed({changed.data(), changed.size()}, &why);
                ASSERT_EQ(!value, !why.empty()) << place << ' ' << byte;
            }
}

TEST(HostilePropertyList, RandomBytes)
{
    std::mt19937 random(20120504); // the same bytes in every run
    for (int round = 0; round < 20'000; ++round) {
        std::vector<char> bytes(random() % 200);
        for (char& byte : bytes)
            byte = static_cast<char>(random());
        parsed({bytes.data(), bytes.size()});
        if (bytes.size() < 40)
            continue;
        // With a header and a trailer that lead to the random objects.
        const std::string list =
            BinaryListBuilder::bigEndian(bytes.size() - 40 < 8 ? 8 : bytes.size() - 40, 8);
        const std::string_view magic = "bplist00";
        std::copy(magic.begin(), magic.end(), bytes.begin());
        std::vector<char> trailer(32, 0);
        trailer[6] = 1;
        trailer[7] = 1;
        trailer[15] = 8;
        std::copy(list.begin(), list.end(), trailer.begin() + 24);
        std::copy(trailer.begin(), trailer.end(), bytes.end() - 32);
        parsed({bytes.data(), bytes.size()});
    }
}

TEST(HostilePropertyList, RandomMarkup)
{
    constexpr std::array pieces{
        "<array>"sv,    "</array>"sv, "<dict>"sv,  "</dict>"sv, "<key>"sv,     "</key>"sv, "<string>"sv,
        "</string>"sv,  "<array/>"sv, "<true/>"sv, "<plist>"sv, "</plist>"sv,  "<!--"sv,   "-->"sv,
        "<![CDATA["sv,  "]]>"sv,      "<?"sv,      "?>"sv,      "\""sv,        "<"sv,      ">"sv,
        "/"sv,          "&amp;"sv,    "&"sv,       ";"sv,       "x"sv,         " "sv,      "<integer>"sv,
        "</integer>"sv, "1"sv,        "<data>"sv,  "</data>"sv, "<!DOCTYPE"sv, "\0"sv};
    std::mt19937 random(20120505);
    int readable = 0;
    for (int round = 0; round < 200'000; ++round) {
        std::string text = round % 2 ? "<array>" : "";
        for (std::size_t i = random() % 12; i > 0; --i)
            text += pieces[random() % pieces.size()];
        text += round % 2 ? "</array>" : "";
        std::vector<char> bytes(text.begin(), text.end());
        std::string why;
        const Value value = parsed({bytes.data(), bytes.size()}, &why);
        ASSERT_NE(why, "libplist cannot read the XML property list") << text;
        readable += value ? 1 : 0;
    }
    EXPECT_GT(readable, 1'000);
}

} // namespace
} // namespace pelorus
