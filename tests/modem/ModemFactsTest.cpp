#include "telephonyd/modem/AccessTechnology.h"
#include "telephonyd/modem/BearerRows.h"
#include "telephonyd/modem/LteBand.h"
#include "telephonyd/modem/ModemSimFiles.h"
#include "telephonyd/modem/ThreeGppLocation.h"

#include <fmt/format.h>
#include <gmock/gmock.h>

namespace pelorus {

namespace {

std::string asLines(const Value& rows)
{
    std::string text;
    for (const auto& [key, value] : *rows.dictionary())
        text += fmt::format("{}: {}\n", key.text(), value.string() ? *value.string() : "no text");
    return text;
}

} // namespace

TEST(AccessTechnology, NewestOfTheGenerationsCounts)
{
    EXPECT_EQ(technologyOn(servingKind(1 << 14)), "Osprey LTE");
    EXPECT_EQ(technologyOn(servingKind(1 << 14 | 1 << 15)), "Osprey LTE"); // 5G beside it
    EXPECT_EQ(technologyOn(servingKind(1 << 16)), "Osprey LTE");
    EXPECT_EQ(technologyOn(servingKind(1 << 17)), "Osprey LTE");
    for (const unsigned bit : {1U, 2U, 3U, 4U})
        EXPECT_EQ(servingKind(1U << bit), CellKind::gsm) << bit;
    for (const unsigned bit : {5U, 6U, 7U, 8U, 9U})
        EXPECT_EQ(servingKind(1U << bit | 1U << 1), CellKind::umts) << bit;
    EXPECT_EQ(technologyOn(CellKind::gsm), "Osprey GSM");
    EXPECT_EQ(technologyOn(CellKind::umts), "Osprey GSM");
    for (const unsigned bits : {0U, 1U, 1U << 10, 1U << 13, 1U << 15, 0xFFFFFFFFU})
        EXPECT_EQ(technologyOn(servingKind(bits)), "") << bits;
}

TEST(AccessTechnology, AbilityDecidesBeforeThereIsANetwork)
{
    EXPECT_EQ(technologyAbleTo(4), "Osprey GSM");
    EXPECT_EQ(technologyAbleTo(4 | 8), "Osprey LTE");
    EXPECT_EQ(technologyAbleTo(8), "Osprey LTE");
    EXPECT_EQ(technologyAbleTo(64), "Osprey LTE");
    EXPECT_EQ(technologyAbleTo(1 | 2 | 32), "");
    EXPECT_EQ(technologyAbleTo(0), "");
}

TEST(LteBand, OfTheEndsOfEachRange)
{
    EXPECT_EQ(lteBand(0), 1);
    EXPECT_EQ(lteBand(599), 1);
    EXPECT_EQ(lteBand(600), 2);
    EXPECT_EQ(lteBand(1300), 3);
    EXPECT_EQ(lteBand(6449), 20);
    EXPECT_EQ(lteBand(6450), 21);
    EXPECT_EQ(lteBand(36000), 33);
    EXPECT_EQ(lteBand(41589), 41);
    EXPECT_EQ(lteBand(66435), 65);
    EXPECT_EQ(lteBand(66436), 66);
    EXPECT_EQ(lteBand(262143), 255);
    for (const unsigned none :
         {4950U, 5009U, 7499U, 10360U, 35999U, 60255U, 65535U, 70546U, 262144U, 0xFFFFFFFFU})
        EXPECT_FALSE(lteBand(none)) << none;
}

TEST(LteBand, OfTheModemsNumber)
{
    EXPECT_EQ(lteBandOfModem(31), 1);
    EXPECT_EQ(lteBandOfModem(50), 20);
    EXPECT_EQ(lteBandOfModem(101), 71);
    EXPECT_FALSE(lteBandOfModem(30));
    EXPECT_FALSE(lteBandOfModem(102));
    EXPECT_FALSE(lteBandOfModem(256)); // any
}

TEST(ThreeGppLocation, OfTheModemsText)
{
    const auto where = ThreeGppLocation::parse("262,01,31C5,83F7CD,2b0c");
    EXPECT_EQ(where.countryCode, 262);
    EXPECT_EQ(where.networkCode, 1);
    EXPECT_EQ(where.locationArea, 0x31C5U);
    EXPECT_EQ(where.cellIdentity, 0x83F7CDU);
    EXPECT_EQ(where.trackingArea, 0x2B0CU);
    const auto older = ThreeGppLocation::parse("310,410,FFFD,FFFFFFF");
    EXPECT_EQ(older.networkCode, 410);
    EXPECT_EQ(older.locationArea, 0xFFFDU);
    EXPECT_EQ(older.cellIdentity, 0xFFFFFFFU);
    EXPECT_FALSE(older.trackingArea);
}

TEST(ThreeGppLocation, KnowsNothingOfWhatCannotBe)
{
    for (const char* text :
         {"", ",", ",,,,", "26,1,FFFE,10000000,FFFF", "2620,0001,-1,zz,10000", "abc,de,0,0,0",
          "262\n,01 ,0x1,1g, 1", "99999999999999999999,1,FFFFFFFFFFFFFFFFF,FFFFFFFFFFFFFFFFF,1 "}) {
        const auto where = ThreeGppLocation::parse(text);
        EXPECT_FALSE(where.countryCode) << text;
        EXPECT_FALSE(where.networkCode) << text;
        EXPECT_FALSE(where.locationArea) << text;
        EXPECT_FALSE(where.trackingArea) << text;
        EXPECT_FALSE(where.cellIdentity) << text;
    }
}

TEST(OperatorCode, HasFiveOrSixDigits)
{
    EXPECT_EQ(OperatorCode::parse("00101").countryCode, 1);
    EXPECT_EQ(OperatorCode::parse("00101").networkCode, 1);
    EXPECT_EQ(OperatorCode::parse("310410").networkCode, 410);
    for (const char* text : {"", "2620", "2620100", "26x01", "+26201"})
        EXPECT_FALSE(OperatorCode::parse(text).countryCode) << text;
}

TEST(ModemSimFiles, AreTexts)
{
    const QVariantMap sim = {{"SimIdentifier", "89490100001234567897"},
                             {"Imsi", "001010123456789"},
                             {"OperatorIdentifier", "00101"},
                             {"OperatorName", "Test Network"},
                             {"Eid", ""}};
    const QVariantMap modem = {{"OwnNumbers", QVariantList{"+491713920012", "", "+491713920013"}},
                               {"CurrentModes", QVariantList{14U, 0U}}};
    EXPECT_EQ(asLines(simFilesOf(sim, modem)), "kSimFile_ICCID: 89490100001234567897\n"
                                               "kSimFile_MSISDN: +491713920012, +491713920013\n"
                                               "kSimFile_AHPLMN: 00101\n"
                                               "kSimFile_RATMODE: LTE, UMTS, GSM\n"
                                               "kSimFile_PNN: Test Network\n");
}

TEST(ModemSimFiles, OfALockedSimAreEmptyAndNotThoseOfTheOneBefore)
{
    EXPECT_EQ(asLines(simFilesOf({}, {{"CurrentModes", QVariantList{0xFFFFFFFFU, 0U}}})),
              "kSimFile_ICCID: \n"
              "kSimFile_MSISDN: \n"
              "kSimFile_AHPLMN: \n"
              "kSimFile_RATMODE: \n"
              "kSimFile_PNN: \n");
}

TEST(BearerRows, OfAConnectedBearer)
{
    const QVariantMap bearer = {
        {"Interface", "wwan0"},
        {"Connected", true},
        {"Properties",
         QVariantMap{{"apn", "internet.example"}, {"ip-type", 4U}, {"user", "ann"}, {"password", "secret"}}},
        {"Ip4Config", QVariantMap{{"method", 2U}, {"address", "192.0.2.37"}, {"dns1", "192.0.2.53"}}},
        {"Ip6Config",
         QVariantMap{{"address", "2001:db8::25"}, {"dns1", "2001:db8::53"}, {"dns2", "2001:db8::54"}}},
        {"Stats", QVariantMap{{"duration", 95U}, {"rx-bytes", 5000000000ULL}, {"tx-bytes", 42ULL}}}};
    EXPECT_EQ(asLines(bearerRows("/org/freedesktop/ModemManager1/Bearer/12", bearer)),
              "Context ID: 12\n"
              "APN: internet.example\n"
              "PDP Type: IPv4v6\n"
              "State: Active\n"
              "Interface: wwan0\n"
              "IPv4 Address: 192.0.2.37\n"
              "IPv6 Address: 2001:db8::25\n"
              "DNS: 192.0.2.53, 2001:db8::53, 2001:db8::54\n"
              "Duration: 95 s\n"
              "Bytes In: 5000000000\n"
              "Bytes Out: 42\n");
}

TEST(BearerRows, OfBearersThatAreNotActive)
{
    EXPECT_EQ(asLines(bearerRows("/1", {{"Properties", QVariantMap{{"apn", "a"}, {"ip-type", 1U}}}})),
              "Context ID: 1\nAPN: a\nPDP Type: IPv4\nState: Inactive\n");
    EXPECT_EQ(asLines(bearerRows("/2", {{"Connected", true},
                                        {"Suspended", true},
                                        {"Properties", QVariantMap{{"ip-type", 8U}}},
                                        {"Stats", QVariantMap{{"duration", -1}}}})),
              "Context ID: 2\nPDP Type: Non-IP\nState: Suspended\n");
    EXPECT_EQ(asLines(bearerRows("/3", {{"Connected", 1}, {"Properties", 5}, {"Interface", 7}})),
              "Context ID: 3\nState: Inactive\n");
}

} // namespace pelorus
