#include "LogGenerator/Osprey/GSM/SimInfo.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

PacketBuilder allFiles()
{
    return internalPacket(makeDictionary({{"kSimFile_OPLMNAcT", "n"},
                                          {"kSimFile_ICCID", "a"},
                                          {"kSimFile_MSISDN", "b"},
                                          {"kSimFile_MBDN", "c"},
                                          {"kSimFile_HPPLMN", "d"},
                                          {"kSimFile_LOCI", "e"},
                                          {"kSimFile_PSLOCI", "f"},
                                          {"kSimFile_ACC", "g"},
                                          {"kSimFile_AD", "h"},
                                          {"kSimFile_FPLMN", "i"},
                                          {"kSimFile_AHPLMN", "j"},
                                          {"kSimFile_RATMODE", "k"},
                                          {"kSimFile_PNN", "l"},
                                          {"kSimFile_OPL", "m"}}));
}

constexpr const char* kAllRows = "EF-ICCID: a\n"
                                 "EF-MSISDN: b\n"
                                 "EF-3GPP MAIL BOX DIALING NUMBER: c\n"
                                 "EF-HPPLMN SEARCH PERIOD: d\n"
                                 "EF-LOCI: e\n"
                                 "EF-GPRS/PS-LOCI: f\n"
                                 "EF-ACCESS CONTROL CLASS: g\n"
                                 "EF-ADMINISTRATIVE DATA: h\n"
                                 "EF-FPLMN: i\n"
                                 "EF-ACTING HPLMN: j\n"
                                 "EF-RAT MODE: k\n"
                                 "EF-PLMN NETWORK NAME: l\n"
                                 "EF-OPERATOR PLMN LIST: m\n"
                                 "EF-OPLMNAcT: n\n";

TEST(SimInfo, ShowsEveryFileInTableOrder)
{
    SectionFixture<SimInfo> section(makeDictionary());
    section.receive(0xFF0000, allFiles());
    EXPECT_EQ(section.shown(), kAllRows);
    EXPECT_THAT(section.logged(), ElementsAre("<4>SimInfo"));
    EXPECT_EQ(section.section.getSectionName(), "SIM Info");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xFF0000));
}

TEST(SimInfo, UpdatesOnlyTheFilesThatAreSent)
{
    SectionFixture<SimInfo> section(makeDictionary());
    section.receive(0xFF0000, allFiles());
    section.receive(0xFF0000, internalPacket(makeDictionary({{"kSimFile_ICCID", "8901"}})));
    EXPECT_EQ(section.shown(), std::string("EF-ICCID: 8901\n") + (kAllRows + 12));
}

TEST(SimInfo, ShowsNothingForAFileThatItDoesNotKnow)
{
    SectionFixture<SimInfo> section(makeDictionary());
    section.receive(0xFF0000,
                    internalPacket(makeDictionary({{"kSimFile_SMSP", "x"}, {"EF-LOCI", "y"}, {"", "z"}})));
    EXPECT_EQ(section.shown(), "");
}

TEST(SimInfo, ShowsAValueAsItWasSent)
{
    SectionFixture<SimInfo> section(makeDictionary());
    const Value sent = makeDictionary({{"kSimFile_ICCID", 12},
                                       {"kSimFile_LOCI", makeData({std::byte{0xFE}})},
                                       {"kSimFile_PNN", makeArray({"one", true})},
                                       {"kSimFile_OPL", makeDictionary({{"name", 1.5}})}});
    section.receive(0xFF0000, internalPacket(sent));
    const Dictionary& rows = *section.entry.dictionary();
    EXPECT_EQ(rows.at("EF-ICCID"), Value(12));
    EXPECT_EQ(rows.at("EF-LOCI"), Value(makeData({std::byte{0xFE}})));
    EXPECT_EQ(rows.at("EF-PLMN NETWORK NAME"), Value(makeArray({"one", true})));
    EXPECT_EQ(rows.at("EF-OPERATOR PLMN LIST"), Value(makeDictionary({{"name", 1.5}})));
}

TEST(SimInfo, ReadsXmlToo)
{
    SectionFixture<SimInfo> section(makeDictionary());
    const auto xml =
        serializePropertyList(makeDictionary({{"kSimFile_ACC", "0001"}}), PropertyListForm::xml).value();
    section.receive(0xFF0000, PacketBuilder(13).u8(0, 0xFF).raw(xml));
    EXPECT_EQ(section.shown(), "EF-ACCESS CONTROL CLASS: 0001\n");
}

TEST(SimInfo, ThrowsOnAPayloadThatCannotBeRead)
{
    SectionFixture<SimInfo> section(makeDictionary());
    section.receive(0xFF0000, allFiles());
    section.logged();
    EXPECT_THROW(section.receive(0xFF0000, PacketBuilder(40).u8(0, 0xFF)),
                 LogCode_0xFF0000::UnknownDataException);
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>SimInfo", "<3>SIM File dictionary data could not be constructed"));
    EXPECT_EQ(section.shown(), kAllRows);
}

TEST(SimInfo, ThrowsOnAPacketWithoutPayload)
{
    SectionFixture<SimInfo> section(makeDictionary());
    for (const std::size_t length : {11U, 12U, 13U}) {
        EXPECT_THROW(section.receive(0xFF0000, PacketBuilder(length)),
                     LogCode_0xFF0000::UnknownDataException);
        EXPECT_THAT(section.logged(),
                    ElementsAre("<4>SimInfo", "<3>SIM File dictionary data could not be constructed"));
    }
}

TEST(SimInfo, IsNotChangedByAPayloadThatIsNoDictionary)
{
    SectionFixture<SimInfo> section(makeDictionary());
    section.receive(0xFF0000, allFiles());
    section.logged();
    section.receive(0xFF0000, internalPacket(makeArray({"kSimFile_ICCID"})));
    section.receive(0xFF0000, internalPacket("kSimFile_ICCID"));
    EXPECT_EQ(section.shown(), kAllRows);
    EXPECT_THAT(section.logged(), ElementsAre("<4>SimInfo", "<4>SimInfo"));
}

TEST(SimInfo, IgnoresAnotherCodeWhateverItCarries)
{
    SectionFixture<SimInfo> section(makeDictionary());
    section.receive(0xFF0002, allFiles());
    section.receive(0x0000, PacketBuilder(5));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>SimInfo", "<4>SimInfo"));
}

} // namespace
} // namespace pelorus::test
