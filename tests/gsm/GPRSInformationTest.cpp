#include "LogGenerator/Osprey/GSM/GPRSInformation.h"
#include "tests/gsm/Packets.h"
#include "tests/gsm/ShownText.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

TEST(GPRSInformation, ShowsEveryRowInTableOrder)
{
    SectionFixture<GPRSInformation> section(makeDictionary());
    section.receive(0x51F5, gprsAccess());
    section.receive(0x7135, registeredArea());
    section.receive(0x51F6, gprsTimers());
    section.receive(0x51FB, packetBroadcast());
    section.receive(0x51FD, packetInformation());
    section.receive(0x51F4, systemInformation13());
    section.receive(0x5137, gsmMeasurement());
    EXPECT_EQ(section.shown(), "Network Control Order: NC2\n"
                               "PFC Supported: Supported\n"
                               "Priority Access Threshold: 1 to 4\n"
                               "Network Operating Mode: Class 2\n"
                               "T3192: 80 ms\n"
                               "Access Burst Type: 11-bit format\n"
                               "DRX Timer Max: 60\n"
                               "PBCCH Present: 9\n"
                               "Ext Measurement Order: 14\n"
                               "Packet PSI Status: 11\n"
                               "Packet SI Status: Supported\n"
                               "Count LR: 12\n"
                               "Count HR: 13\n"
                               "SI13 Position: Located on Extended BCCH\n"
                               "Cell Reselect Hysteresis: Applied\n");
    EXPECT_THAT(section.section.getLogCodeArray(),
                ElementsAre(0x51F5, 0x7135, 0x51F6, 0x51FB, 0x51FD, 0x51F4, 0x5137));
}

TEST(GPRSInformation, OverwritesOnlyTheRowsThatThePacketCarries)
{
    SectionFixture<GPRSInformation> section(makeDictionary());
    section.receive(0x51F5, gprsAccess());
    section.receive(0x51F4, systemInformation13());
    section.receive(0x51F5, PacketBuilder(18));
    EXPECT_EQ(section.shown(), "Network Control Order: NC0\n"
                               "PFC Supported: Not Supported\n"
                               "Priority Access Threshold: Barred (PKT access not allowed in the Cell)\n"
                               "SI13 Position: Located on Extended BCCH\n");
}

TEST(GPRSInformation, TakesItsNeighbouringCodesForUnknown)
{
    SectionFixture<GPRSInformation> section(makeDictionary());
    for (const LogCode code : {0x51F7U, 0x51F8U, 0x51F9U, 0x51FAU, 0x51FCU}) {
        section.receive(code, PacketBuilder(400));
        EXPECT_THAT(
            section.logged(),
            ElementsAre("<4>GPRSInformation", "<3>Received an unknown log message: " + std::to_string(code)));
    }
    EXPECT_EQ(section.shown(), "");
}

INSTANTIATE_TEST_SUITE_P(
    GPRSControlOrder, ShownTextOf,
    shownTexts(
        "GPRS Information", 0x51F5, 18, 15, "Network Control Order",
        {{0, "NC0"}, {1, "NC1"}, {2, "NC2"}, {3, "Unknown"}, {254, "Unknown"}, {255, "Not Available"}}));
INSTANTIATE_TEST_SUITE_P(
    GPRSFlowContexts, ShownTextOf,
    shownTexts(
        "GPRS Information", 0x51F5, 18, 13, "PFC Supported",
        {{0, "Not Supported"}, {1, "Supported"}, {2, "Unknown"}, {254, "Unknown"}, {255, "Available"}}));
INSTANTIATE_TEST_SUITE_P(GPRSAccessThreshold, ShownTextOf,
                         shownTexts("GPRS Information", 0x51F5, 18, 14, "Priority Access Threshold",
                                    {{0, "Barred (PKT access not allowed in the Cell)"},
                                     {1, "Barred"},
                                     {2, "Barred"},
                                     {3, "1 Only"},
                                     {4, "1 to 2"},
                                     {5, "1 to 3"},
                                     {6, "1 to 4"},
                                     {7, "Allowed"},
                                     {8, "Unknown"},
                                     {254, "Unknown"},
                                     {255, "Not Available"}}));
INSTANTIATE_TEST_SUITE_P(
    GPRSOperatingMode, ShownTextOf,
    shownTexts("GPRS Information", 0x7135, 32, 13, "Network Operating Mode",
               {{0, "Class 1"}, {1, "Class 2"}, {2, "Class 3"}, {3, "Unknown"}, {255, "Unknown"}}));
INSTANTIATE_TEST_SUITE_P(GPRSReleaseTimer, ShownTextOf,
                         shownTexts("GPRS Information", 0x51F6, 24, 15, "T3192",
                                    {{0, "500 ms"},
                                     {1, "1000 ms"},
                                     {2, "1500 ms"},
                                     {3, "0 ms"},
                                     {4, "80 ms"},
                                     {5, "120 ms"},
                                     {6, "160 ms"},
                                     {7, "200 ms"},
                                     {8, "?? ms"},
                                     {9, "?? ms"},
                                     {255, "?? ms"}}));
INSTANTIATE_TEST_SUITE_P(GPRSAccessBursts, ShownTextOf,
                         shownTexts("GPRS Information", 0x51F6, 24, 17, "Access Burst Type",
                                    {{0, "8-bit format"}, {1, "11-bit format"}, {255, "11-bit format"}}));
INSTANTIATE_TEST_SUITE_P(GPRSTimerMaximum, ShownTextOf,
                         shownTexts("GPRS Information", 0x51F6, 24, 16, "DRX Timer Max",
                                    {{0, "0"}, {255, "255"}}));
INSTANTIATE_TEST_SUITE_P(GPRSBroadcast, ShownTextOf,
                         shownTexts("GPRS Information", 0x51FB, 34, 13, "PBCCH Present",
                                    {{0, "0"}, {1, "1"}, {255, "255"}}));
INSTANTIATE_TEST_SUITE_P(GPRSPacketSystemInformation, ShownTextOf,
                         shownTexts("GPRS Information", 0x51FD, 35, 33, "Packet SI Status",
                                    {{0, "Not Supported"}, {1, "Supported"}, {255, "Supported"}}));
INSTANTIATE_TEST_SUITE_P(GPRSPosition, ShownTextOf,
                         shownTexts("GPRS Information", 0x51F4, 15, 14, "SI13 Position",
                                    {{0, "Located on BCCH"},
                                     {1, "Located on Extended BCCH"},
                                     {2, "Unknown"},
                                     {254, "Unknown"},
                                     {255, "Not Available"}}));
INSTANTIATE_TEST_SUITE_P(GPRSHysteresis, ShownTextOf,
                         shownTexts("GPRS Information", 0x5137, 29, 26, "Cell Reselect Hysteresis",
                                    {{0, "Not Applied"}, {1, "Applied"}, {255, "Applied"}}));

} // namespace
} // namespace pelorus::test
