#include "LogGenerator/Osprey/GSM/ServingPLMN.h"
#include "tests/gsm/Packets.h"
#include "tests/gsm/ShownText.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

TEST(ServingPLMN, ShowsTheAreaInOrderThenTheSelectionMode)
{
    SectionFixture<ServingPLMN> section(makeDictionary());
    section.receive(0x7135, registeredArea());
    section.receive(0x7132, registrationState());
    EXPECT_EQ(section.shown(), "Mobile Country Code: 310\n"
                               "Mobile Network Code: 26 \n" // two digits: the blank is meant
                               "Location Area Code: 4660\n"
                               "Routing Area Code: 7\n"
                               "Service Type: CS_PS_SERVICE\n"
                               "PLMN Sel Mod: Manual\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving PLMN", "<4>Serving PLMN"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x7135, 0x7132, 0xFF0001));
}

TEST(ServingPLMN, ReadsANetworkCodeOfThreeDigits)
{
    SectionFixture<ServingPLMN> section(makeDictionary());
    section.receive(0x7135, PacketBuilder(32).u8(15, 0x21).u8(16, 0x43).u8(17, 0x65));
    EXPECT_EQ(section.row("Mobile Country Code"), "123");
    EXPECT_EQ(section.row("Mobile Network Code"), "564");
}

TEST(ServingPLMN, ShowsABlankForEachFiller)
{
    SectionFixture<ServingPLMN> section(makeDictionary());
    section.receive(0x7135, PacketBuilder(32).u8(15, 0xA9).u8(16, 0x9F).u8(17, 0xFA));
    EXPECT_EQ(section.row("Mobile Country Code"), "9  ");
    EXPECT_EQ(section.row("Mobile Network Code"), "  9");
}

TEST(ServingPLMN, ReadsTheLocationAreaBigEndianUnsigned)
{
    SectionFixture<ServingPLMN> section(makeDictionary());
    section.receive(0x7135, PacketBuilder(32).u8(18, 0xFF).u8(19, 0xFE).u8(20, 255));
    EXPECT_EQ(section.row("Location Area Code"), "65534");
    EXPECT_EQ(section.row("Routing Area Code"), "255");
}

TEST(ServingPLMN, KeepsItsRowsWhenTheAreaIsOneByteShort)
{
    SectionFixture<ServingPLMN> section(makeDictionary());
    section.receive(0x7135, registeredArea());
    const std::string before = section.shown();
    section.receive(0x7135, PacketBuilder(31));
    EXPECT_EQ(section.shown(), before);
}

TEST(ServingPLMN, TakesTheFirstServingCellOfUMTSOrGSM)
{
    SectionFixture<ServingPLMN> section(makeDictionary());
    section.receive(0xFF0001, monitoredCells({gsmNeighbor(), umtsServingCell(), gsmServingCell()}));
    EXPECT_EQ(section.shown(), "Mobile Country Code: 310\n"
                               "Mobile Network Code: 410\n"
                               "Location Area Code: 4321\n");
    section.receive(0xFF0001, monitoredCells({gsmServingCell(), umtsServingCell()}));
    EXPECT_EQ(section.shown(), "Mobile Country Code: 262\n"
                               "Mobile Network Code: 1\n"
                               "Location Area Code: 1234\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving PLMN", "<4>Serving PLMN"));
}

TEST(ServingPLMN, OverwritesTheRowsThatBothSourcesHave)
{
    SectionFixture<ServingPLMN> section(makeDictionary());
    section.receive(0x7135, registeredArea());
    section.receive(0xFF0001, monitoredCells({gsmServingCell()}));
    EXPECT_EQ(section.shown(), "Mobile Country Code: 262\n"
                               "Mobile Network Code: 1\n"
                               "Location Area Code: 1234\n"
                               "Routing Area Code: 7\n"
                               "Service Type: CS_PS_SERVICE\n");
    section.receive(0x7135, registeredArea());
    EXPECT_EQ(section.row("Mobile Country Code"), "310");
}

TEST(ServingPLMN, IgnoresAServingCellOfLTE)
{
    SectionFixture<ServingPLMN> section(makeDictionary());
    section.receive(0xFF0001, monitoredCells({gsmServingCell()}));
    const std::string before = section.shown();
    section.logged();
    section.receive(0xFF0001,
                    monitoredCells({cell("LTE", "Serving", {{"CellMonitorMCC", 1}, {"CellMonitorMNC", 2}})}));
    EXPECT_EQ(section.shown(), before);
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving PLMN"));
}

TEST(ServingPLMN, LogsEachMissingNumberAndShowsTheOthers)
{
    SectionFixture<ServingPLMN> section(makeDictionary());
    section.receive(0xFF0001, monitoredCells({cell("GSM", "Serving", {{"CellMonitorMNC", 3}})}));
    EXPECT_EQ(section.shown(), "Mobile Network Code: 3\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving PLMN", "<3>ServingPLMN: Failed to retrieve MCC\n",
                                              "<3>ServingPLMN: Failed to retrieve LAC\n"));
    section.receive(0xFF0001,
                    monitoredCells({cell(
                        "UMTS", "Serving",
                        {{"CellMonitorMCC", "310"}, {"CellMonitorMNC", "many"}, {"CellMonitorLAC", 5}})}));
    EXPECT_EQ(section.shown(), "Mobile Network Code: 3\n"
                               "Mobile Country Code: 310\n"
                               "Location Area Code: 5\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving PLMN", "<3>ServingPLMN: Failed to retrieve MNC\n"));
}

INSTANTIATE_TEST_SUITE_P(ServingPLMNServiceType, ShownTextOf,
                         shownTexts("Serving PLMN", 0x7135, 32, 14, "Service Type",
                                    {{0, "NO_SERVICE"},
                                     {1, "CS_ONLY"},
                                     {2, "PS_ONLY"},
                                     {3, "CS_PS_SERVICE"},
                                     {4, "LIMITED_SERVICE"},
                                     {5, "Unknown"},
                                     {255, "Unknown"}}));
INSTANTIATE_TEST_SUITE_P(ServingPLMNSelectionMode, ShownTextOf,
                         shownTexts("Serving PLMN", 0x7132, 16, 14, "PLMN Sel Mod",
                                    {{0, "Automatic"},
                                     {1, "Manual"},
                                     {2, "Limited"},
                                     {3, "LIMITED_ROUTINE_ACQ"},
                                     {4, "LIMITED_MANUAL_ACQ"},
                                     {5, "Unknown"},
                                     {255, "Unknown"}}));

} // namespace
} // namespace pelorus::test
