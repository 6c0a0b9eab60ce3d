#include "tests/platform/BinaryListBuilder.h"
#include "tests/platform/PropertyListText.h"

#include <gtest/gtest.h>

#include <bit>
#include <limits>

namespace pelorus {
namespace {

using namespace std::literals;

Value readObject(std::string_view object)
{
    return parsed(BinaryListBuilder().object(object).bytes());
}
std::string refusedObject(std::string_view object)
{
    return refusal(BinaryListBuilder().object(object).bytes());
}

std::string date(double seconds)
{
    return "\x33"s + BinaryListBuilder::bigEndian(std::bit_cast<std::uint64_t>(seconds), 8);
}

TEST(BinaryPropertyList, ReadsEveryKind)
{
    EXPECT_EQ(readObject("\x08"), Value(false));
    EXPECT_EQ(readObject("\x09"), Value(true));
    EXPECT_EQ(readObject("\x10\xFF"), Value(255));
    EXPECT_EQ(readObject("\x11\xFF\xFE"), Value(65534));
    EXPECT_EQ(readObject("\x12\xFF\xFF\xFF\xFF"), Value(4294967295));
    EXPECT_EQ(readObject("\x13\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFB"), Value(-5));
    EXPECT_EQ(readObject("\x13\x80\0\0\0\0\0\0\0"sv), Value(std::numeric_limits<std::int64_t>::min()));
    EXPECT_EQ(readObject("\x14\0\0\0\0\0\0\0\0\x7F\xFF\xFF\xFF\xFF\xFF\xFF\xFF"sv),
              Value(std::numeric_limits<std::int64_t>::max()));
    EXPECT_EQ(readObject("\x22\xC0\x20\0\0"sv), Value(-2.5));
    EXPECT_EQ(readObject("\x23\x3F\xB9\x99\x99\x99\x99\x99\x9A"), Value(0.1));
    EXPECT_EQ(readObject("\x43\x01\x02\xFF"), Value(makeData({std::byte{1}, std::byte{2}, std::byte{255}})));
    EXPECT_EQ(readObject("\x40"), Value(makeData({})));
    EXPECT_EQ(readObject("\x50"), Value(""));
    EXPECT_EQ(readObject("\x53"
                         "abc"),
              Value("abc"));
    EXPECT_EQ(readObject("\x80\x07"), Value(7));
    EXPECT_EQ(readObject("\x83\xFF\xFF\xFF\xFF"), Value(4294967295));
    EXPECT_EQ(readObject("\xA0"), Value(makeArray()));
    EXPECT_EQ(readObject("\xD0"), Value(makeDictionary()));
}

TEST(BinaryPropertyList, ReadsUtf16)
{
    EXPECT_EQ(readObject("\x62\0Z\0\xFC"sv), Value("Z\xC3\xBC"));
    EXPECT_EQ(readObject("\x61\x20\xAC"), Value("\xE2\x82\xAC"));
    EXPECT_EQ(readObject("\x64\0a\xD8\x3D\xDE\0\0b"sv), Value("a\xF0\x9F\x98\x80"
                                                              "b"));
    EXPECT_EQ(
        readObject("\x6F\x10\x10"s + std::string("\0x\0x\0x\0x\0x\0x\0x\0x\0x\0x\0x\0x\0x\0x\0x\xFF!", 32)),
        Value("xxxxxxxxxxxxxxx\xEF\xBC\xA1"));
}

TEST(BinaryPropertyList, ShowsHalvesOfSurrogatePairsAsNoCharacter)
{
    EXPECT_EQ(readObject("\x61\xD8\x3D"), Value("\xEF\xBF\xBD"));
    EXPECT_EQ(readObject("\x62\xDE\0\0b"sv), Value("\xEF\xBF\xBD"
                                                   "b"));
    EXPECT_EQ(readObject("\x63\xD8\x3D\xD8\x3D\xDE\0"sv), Value("\xEF\xBF\xBD\xF0\x9F\x98\x80"));
    EXPECT_EQ(readObject("\x61\x07\xFF"), Value("\xDF\xBF"));
    EXPECT_EQ(readObject("\x62\xDB\xFF\xDF\xFF"), Value("\xF4\x8F\xBF\xBF"));
}

TEST(BinaryPropertyList, ReadsDatesToTheMicrosecond)
{
    EXPECT_EQ(readObject(date(0)), Value(dateAt(978307200)));
    EXPECT_EQ(readObject(date(357816600)), Value(dateAt(1336123800)));
    EXPECT_EQ(readObject(date(357816600.123456)), Value(dateAt(1336123800, 123456)));
    EXPECT_EQ(readObject(date(0.5)), Value(dateAt(978307200, 500000)));
    EXPECT_EQ(readObject(date(-0.25)), Value(dateAt(978307199, 750000)));
    EXPECT_EQ(readObject(date(-978307200.5)), Value(dateAt(-1, 500000)));
    EXPECT_EQ(readObject(date(63113904000)), Value(dateAt(64092211200)));
    EXPECT_EQ(readObject(date(-63114076800)), Value(dateAt(-62135769600)));
}

TEST(BinaryPropertyList, KeepsAMicrosecondBesideAWholeSecond)
{
    for (const std::int64_t microseconds : {-1, 1, 999'999})
        EXPECT_EQ(
            parsePropertyList(*serializePropertyList(dateAt(0, microseconds), PropertyListForm::binary)),
            Value(dateAt(0, microseconds)))
            << microseconds;
}

TEST(BinaryPropertyList, WritesDatesToTheMicrosecond)
{
    for (const std::int64_t microseconds : {1, 123456, 500000, 999999}) {
        const Value value = dateAt(1336123800, microseconds);
        EXPECT_EQ(parsed(serialized(value, PropertyListForm::binary)), value) << microseconds;
    }
}

TEST(BinaryPropertyList, ReadsSharedObjectsForEveryReference)
{
    const std::string list = BinaryListBuilder()
                                 .array({1, 2, 1, 2})
                                 .string("shared")
                                 .dictionary({1}, {3})
                                 .object("\x10\x07")
                                 .bytes();
    const Value record = makeDictionary({{"shared", 7}});
    const Value back = parsed(list);
    EXPECT_EQ(back, Value(makeArray({"shared", record, "shared", record})));
    back.array()->elements[1].dictionary()->set("shared", 8);
    EXPECT_EQ(back.array()->elements[3], record);
}

TEST(BinaryPropertyList, KeepsOrderAndTheLastValueOfARepeatedKey)
{
    const std::string list = BinaryListBuilder()
                                 .dictionary({1, 2, 1, 3}, {4, 5, 6, 7})
                                 .string("z")
                                 .string("a")
                                 .string("z")
                                 .object("\x10\x01")
                                 .object("\x10\x02")
                                 .object("\x10\x03")
                                 .object("\x10\x04")
                                 .bytes();
    const Value back = parsed(list);
    ASSERT_TRUE(back.dictionary());
    std::string shown;
    for (const auto& [key, value] : *back.dictionary())
        shown += std::string(key.text()) + "=" + std::to_string(*value.integer()) + " ";
    EXPECT_EQ(shown, "z=4 a=2 ");
}

TEST(BinaryPropertyList, ReadsRecordsWhoseKeysDifferOrRepeat)
{
    BinaryListBuilder list;
    list.array({1, 2, 3, 4, 5})
        .dictionary({6, 7}, {8, 9})
        .dictionary({6, 7}, {9, 8})
        .dictionary({7, 6}, {8, 9});
    list.dictionary({6}, {9}).dictionary({6, 7, 6}, {8, 8, 9});
    list.string("CellId").string("Band").object("\x10\x01").object("\x10\x02");
    const Value back = parsed(list.bytes());
    EXPECT_EQ(back,
              Value(makeArray({makeDictionary({{"CellId", 1}, {"Band", 2}}),
                               makeDictionary({{"CellId", 2}, {"Band", 1}}),
                               makeDictionary({{"Band", 1}, {"CellId", 2}}), makeDictionary({{"CellId", 2}}),
                               makeDictionary({{"CellId", 2}, {"Band", 1}})})));
    EXPECT_EQ(back.array()->elements[4].dictionary()->begin()->key.text(), "CellId");
}

TEST(BinaryPropertyList, ReadsEverySizeOfOffsetAndReference)
{
    for (std::size_t size = 1; size <= 8; ++size) {
        BinaryListBuilder list;
        list.offsetSize = size;
        list.referenceSize = size;
        list.root = 1;
        list.string("x").array({0, 2, 0}).object("\x10\x05");
        EXPECT_EQ(parsed(list.bytes()), Value(makeArray({"x", 5, "x"}))) << size;
    }
}

TEST(BinaryPropertyList, ReadsADictionaryOfVeryManyEntries)
{
    constexpr std::uint64_t count = 100'000;
    BinaryListBuilder list;
    list.referenceSize = 4;
    std::vector<std::uint64_t> keys;
    std::vector<std::uint64_t> values;
    for (std::uint64_t i = 0; i < count; ++i) {
        list.string("k"s + std::to_string(i % (count - 1))); // the last repeats the first
        keys.push_back(i);
        values.push_back(i);
    }
    list.root = count;
    list.dictionary(keys, values);
    const Value back = parsed(list.bytes());
    ASSERT_TRUE(back.dictionary());
    EXPECT_EQ(back.dictionary()->size(), 99'999U);
    EXPECT_EQ(back.dictionary()->begin()->key.text(), "k0");
    EXPECT_EQ((back.dictionary()->end() - 1)->key.text(), "k99998");
}

TEST(BinaryPropertyList, RefusesObjectsThatAreNoValues)
{
    EXPECT_EQ(refusedObject("\0"sv), "the binary property list holds an object of the unknown type 0x00");
    EXPECT_EQ(refusedObject("\x0F"), "the binary property list holds an object of the unknown type 0x0F");
    EXPECT_EQ(refusedObject("\xC0"), "the binary property list holds an object of the unknown type 0xC0");
    EXPECT_EQ(refusedObject("\x70"), "the binary property list holds an object of the unknown type 0x70");
    EXPECT_EQ(refusedObject("\x21\0\0"sv),
              "the binary property list holds an object of the unknown type 0x21");
    EXPECT_EQ(refusedObject("\x32\0\0\0\0"sv),
              "the binary property list holds an object of the unknown type 0x32");
    EXPECT_EQ(refusedObject("\x15"s + std::string(32, '\0')),
              "the binary property list holds an object of the unknown type 0x15");
    EXPECT_EQ(refusedObject(date(std::numeric_limits<double>::quiet_NaN())),
              "the binary property list holds a date outside the years 0 to 9999");
    EXPECT_EQ(refusedObject(date(1e300)),
              "the binary property list holds a date outside the years 0 to 9999");
    EXPECT_EQ(refusedObject("\x53"
                            "a\0b"sv),
              "the binary property list holds a NUL in a string");
    EXPECT_EQ(refusedObject("\x62\0a\0\0"sv), "the binary property list holds a NUL in a string");
    EXPECT_EQ(refusedObject("\x84\xFF\xFF\xFF\xFF\xFF"),
              "the binary property list holds an object of the unknown type 0x84");
}

TEST(BinaryPropertyList, RefusesKeysThatAreNoStrings)
{
    EXPECT_EQ(refusal(BinaryListBuilder().dictionary({1}, {1}).object("\x10\x01").bytes()),
              "object 1 of the binary property list is a key and no string");
    EXPECT_EQ(refusal(BinaryListBuilder().dictionary({0}, {1}).object("\x10\x01").bytes()),
              "object 0 of the binary property list is a key and no string");
    EXPECT_EQ(refusal(BinaryListBuilder().dictionary({1}, {1}).object("\x61\0\0"sv).bytes()),
              "the binary property list holds a NUL in a string");
}

TEST(BinaryPropertyList, RefusesObjectsThatReachBeyondTheData)
{
    const std::string beyond =
        "an object of the binary property list at 9 reaches beyond the objects' end at ";
    EXPECT_EQ(refusedObject("\x54"
                            "abc"),
              beyond + "12");
    EXPECT_EQ(refusedObject("\x62\0a\0"sv), beyond + "12");
    EXPECT_EQ(refusedObject("\x13\0\0"sv), beyond + "11");
    EXPECT_EQ(refusedObject("\x23\0\0"sv), beyond + "11");
    EXPECT_EQ(refusedObject("\x33\0\0"sv), beyond + "11");
    EXPECT_EQ(refusedObject("\x81\0"sv), beyond + "10");
    EXPECT_EQ(refusedObject("\xA1"), beyond + "9");
    EXPECT_EQ(refusedObject("\xD1\0"sv), beyond + "10");
    for (const unsigned kind : {0x4FU, 0x5FU, 0x6FU, 0xAFU, 0xDFU}) {
        const std::string marker(1, static_cast<char>(kind));
        for (const std::string_view count :
             {"\x13\x7F\xFF\xFF\xFF\xFF\xFF\xFF\xFF"sv, "\x13\x80\0\0\0\0\0\0\0"sv,
              "\x13\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF"sv, "\x12\xFF\xFF\xFF\xFF"sv, "\x10\xFF"sv})
            EXPECT_NE(refusedObject(marker + std::string(count) + "abcdefgh"), "") << kind;
        for (const std::string_view count :
             {""sv, "\x10"sv, "\x11\0"sv, "\x20\x01"sv, "\x50"sv, "\x14\0\0"sv, "\x1F"sv})
            EXPECT_EQ(refusedObject(marker + std::string(count)),
                      "object 0 of the binary property list has no proper count");
    }
}

TEST(BinaryPropertyList, RefusesBadTrailers)
{
    constexpr std::uint64_t huge = 1ULL << 63;
    const BinaryListBuilder list = BinaryListBuilder().array({1}).string("x");
    ASSERT_EQ(parsed(list.bytes(4, 1, 2, 0, 12)), Value(makeArray({"x"})));
    EXPECT_EQ(refusal(list.bytes(0, 1, 2, 0, 12)),
              "the binary property list has offsets of 0 and references of 1 bytes");
    EXPECT_EQ(refusal(list.bytes(200, 1, 2, 0, 12)),
              "the binary property list has offsets of 200 and references of 1 bytes");
    EXPECT_EQ(refusal(list.bytes(4, 0, 2, 0, 12)),
              "the binary property list has offsets of 4 and references of 0 bytes");
    EXPECT_EQ(refusal(list.bytes(4, 255, 2, 0, 12)),
              "the binary property list has offsets of 4 and references of 255 bytes");
    EXPECT_EQ(refusal(list.bytes(4, 1, huge, 0, 12)),
              "the binary property list is 52 bytes and says that 9223372036854775808 offsets start at 12");
    EXPECT_EQ(refusal(list.bytes(4, 1, 3, 0, 12)),
              "the binary property list is 52 bytes and says that 3 offsets start at 12");
    EXPECT_EQ(refusal(list.bytes(4, 1, 2, 2, 12)),
              "the binary property list has 2 objects, refers to object 2");
    EXPECT_EQ(refusal(list.bytes(4, 1, 2, huge, 12)),
              "the binary property list has 2 objects, refers to object 9223372036854775808");
    EXPECT_EQ(refusal(list.bytes(4, 1, 0, 0, 12)),
              "the binary property list has 0 objects, refers to object 0");
    for (const std::uint64_t table : {std::uint64_t{0}, std::uint64_t{7}, std::uint64_t{13},
                                      std::uint64_t{21}, std::uint64_t{52}, huge, ~std::uint64_t{0}})
        EXPECT_NE(refusal(list.bytes(4, 1, 2, 0, table)), "") << table;
    EXPECT_EQ(refusal("bplist00"), "the binary property list is 8 bytes, needs 40");
}

TEST(BinaryPropertyList, RefusesOffsetsAndReferencesThatLeadAstray)
{
    EXPECT_EQ(refusal(BinaryListBuilder().array({1}).bytes()),
              "the binary property list has 1 objects, refers to object 1");
    BinaryListBuilder outside;
    outside.array({1}).string("x");
    std::string bytes = outside.bytes();
    for (const char offset : {'\0', '\7', '\14', '\77'}) {
        bytes[12 + 7] = offset; // of object 1
        EXPECT_EQ(refusal(bytes), "object 1 of the binary property list is at " + std::to_string(+offset) +
                                      ", outside the objects");
    }
}

} // namespace
} // namespace pelorus
