#include "LogGenerator/Osprey/GSM/ProcessCO.h"
#include "LogGenerator/Osprey/GSM/ProcessCS.h"
#include "LogGenerator/Osprey/GSM/ProcessPS.h"
#include "tests/gsm/Packets.h"
#include "tests/gsm/ShownText.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

TEST(ProcessCO, ShowsTheStatesOnlyUnderTheBannerOfTheCSSection)
{
    SectionFixture<ProcessCO> section(makeDictionary());
    section.receive(0x7131, circuitSwitchedState());
    section.receive(0x7132, registrationState());
    EXPECT_EQ(section.shown(), "MM State: MM_IDLE\n"
                               "MM Service State: REG_STATE_AUTOMATIC_SEARCH\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>ProcessCS", "<4>ProcessCS"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x7131, 0x7132));
}

TEST(ProcessCS, ShowsStateSubStateAndCauseInOrder)
{
    SectionFixture<ProcessCS> section(makeDictionary());
    section.receive(0x7131, circuitSwitchedState());
    section.receive(0x7132, registrationState());
    EXPECT_EQ(section.shown(), "MM State: MM_IDLE\n"
                               "MM Sub State: MM_NORMAL_SERVICE\n"
                               "LU Reject Cause: ROAMING_NOT_ALLOWED\n"
                               "MM Service State: REG_STATE_AUTOMATIC_SEARCH\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>ProcessCS", "<4>ProcessCS"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x7131, 0x7132));
}

TEST(ProcessPS, ShowsStateSubStateAndCauseInOrder)
{
    SectionFixture<ProcessPS> section(makeDictionary());
    section.receive(0x7130, packetSwitchedState());
    section.receive(0x7132, registrationState());
    EXPECT_EQ(section.shown(), "MM State: GMM_REGISTERED\n"
                               "MM Sub State: GMM_ATTEMPING_TO_UPDATE\n"
                               "Attach Reject Cause: GMM_GU2_NOT_UPDATED\n"
                               "MM Service State: REG_STATE_AUTOMATIC_SEARCH\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>ProcessPS", "<4>ProcessPS"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x7130, 0x7132));
}

TEST(ProcessCS, OverwritesOnlyTheRowsThatThePacketCarries)
{
    SectionFixture<ProcessCS> section(makeDictionary());
    section.receive(0x7131, circuitSwitchedState());
    section.receive(0x7132, registrationState());
    section.receive(0x7131, PacketBuilder(16).u8(13, 6).u8(14, 1).u8(15, 0));
    EXPECT_EQ(section.shown(), "MM State: MM_CONNECTION_ACTIVE\n"
                               "MM Sub State: MM_NO_IMSI\n"
                               "LU Reject Cause: UPDATED\n"
                               "MM Service State: REG_STATE_AUTOMATIC_SEARCH\n");
}

TEST(ProcessPS, DoesNotDecodeTheCircuitSwitchedState)
{
    SectionFixture<ProcessPS> section(makeDictionary());
    section.receive(0x7131, circuitSwitchedState());
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>ProcessPS", "<3>Received an unknown log message: 28977"));
}

TEST(ProcessSections, KeepTheirRowsWhenTheRegistrationIsOneByteShort)
{
    SectionFixture<ProcessCO> co(makeDictionary());
    SectionFixture<ProcessCS> cs(makeDictionary());
    SectionFixture<ProcessPS> ps(makeDictionary());
    co.receive(0x7132, registrationState().length(15));
    cs.receive(0x7132, registrationState().length(15));
    ps.receive(0x7132, registrationState().length(15));
    EXPECT_EQ(co.shown() + cs.shown() + ps.shown(), "");
}

const auto kRegistrationStates = {std::pair{0U, "REG_STATE_INACTIVE"},
                                  {1U, "REG_STATE_IDLE"},
                                  {2U, "REG_STATE_REGISTERING"},
                                  {3U, "REG_STATE_DEREGISTERING"},
                                  {4U, "REG_STATE_MANUAL_SEARCH"},
                                  {5U, "REG_STATE_AUTOMATIC_SEARCH"},
                                  {6U, "REG_STATE_OFFLINE"},
                                  {7U, "Unknown"},
                                  {255U, "Unknown"}};
const auto kMobilityStates = {std::pair{0U, "MM_NULL"},
                              {1U, "Unknown"},
                              {2U, "Unknown"},
                              {3U, "MM_LOCATION_UPDATE_INITIATED"},
                              {4U, "Unknown"},
                              {5U, "MM_WAIT_FOR_OUTGOING_MM_CONNECTION"},
                              {6U, "MM_CONNECTION_ACTIVE"},
                              {7U, "MM_IMSI_DETACH_INITIATED"},
                              {8U, "MM_PROCESS_CM_SERVICE_PROMPT"},
                              {9U, "MM_WAIT_FOR_NETWORK_COMMAND"},
                              {10U, "MM_LOCATION_UPDATE_REJECTED"},
                              {11U, "Unknown"},
                              {12U, "Unknown"},
                              {13U, "MM_WAIT_FOR_RR_CONNECTION_LU"},
                              {14U, "MM_WAIT_FOR_RR_CONNECTION_MM"},
                              {15U, "MM_WAIT_FOR_RR_CONNECTION_IMSI_DETACH"},
                              {16U, "Unknown"},
                              {17U, "MM_REESTABLISHMENT_INITIATED"},
                              {18U, "MM_WAIT_FOR_RR_ACTIVE"},
                              {19U, "MM_IDLE"},
                              {20U, "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION"},
                              {21U, "MM_WAIT_FOR_RR_CONNECTION_ REESTABLISHMENT"},
                              {22U, "MM_WAIT_FOR_REESTABLISH_DECISION"},
                              {23U, "MM_LOCATION_UPDATING_PENDING"},
                              {24U, "Unknown"},
                              {25U, "MM_RR_CONNECTION_RELEASE_NOT_ALLOWED"},
                              {26U, "Unknown"},
                              {255U, "Unknown"}};

INSTANTIATE_TEST_SUITE_P(ProcessCORegistration, ShownTextOf,
                         shownTexts("Process CO", 0x7132, 16, 13, "MM Service State", kRegistrationStates));
INSTANTIATE_TEST_SUITE_P(ProcessCSRegistration, ShownTextOf,
                         shownTexts("Process CS", 0x7132, 16, 13, "MM Service State", kRegistrationStates));
INSTANTIATE_TEST_SUITE_P(ProcessPSRegistration, ShownTextOf,
                         shownTexts("Process PS", 0x7132, 16, 13, "MM Service State", kRegistrationStates));
INSTANTIATE_TEST_SUITE_P(ProcessCOState, ShownTextOf,
                         shownTexts("Process CO", 0x7131, 16, 13, "MM State", kMobilityStates));
INSTANTIATE_TEST_SUITE_P(ProcessCSState, ShownTextOf,
                         shownTexts("Process CS", 0x7131, 16, 13, "MM State", kMobilityStates));
INSTANTIATE_TEST_SUITE_P(ProcessCSSubState, ShownTextOf,
                         shownTexts("Process CS", 0x7131, 16, 14, "MM Sub State",
                                    {{0, "MM_NULL_SUBSTATE"},
                                     {1, "MM_NO_IMSI"},
                                     {2, "MM_PLMN_SEARCH"},
                                     {3, "MM_LIMITED_SERVICE"},
                                     {4, "MM_ATTEMPTING_TO_UPDATE"},
                                     {5, "MM_LOCATION_UPDATE_NEEDED"},
                                     {6, "MM_NO_CELL_AVAILABLE"},
                                     {7, "MM_PLMN_SEARCH_NORMAL_SERVICE"},
                                     {8, "MM_NORMAL_SERVICE"},
                                     {9, "Unknown"},
                                     {255, "Unknown"}}));
INSTANTIATE_TEST_SUITE_P(ProcessCSCause, ShownTextOf,
                         shownTexts("Process CS", 0x7131, 16, 15, "LU Reject Cause",
                                    {{0, "UPDATED"},
                                     {1, "NOT_UPDATED"},
                                     {2, "ROAMING_NOT_ALLOWED"},
                                     {3, "LOCATION_AREA_NOT_ALLOWED"},
                                     {4, "Unknown"},
                                     {255, "Unknown"}}));
INSTANTIATE_TEST_SUITE_P(ProcessPSState, ShownTextOf,
                         shownTexts("Process PS", 0x7130, 16, 13, "MM State",
                                    {{0, "GMM_NULL"},
                                     {1, "GMM_DEREGISTERED"},
                                     {2, "GMM_REGISTERED_INITIATED"},
                                     {3, "GMM_REGISTERED"},
                                     {4, "GMM_DEREGISTERED_INITIATED"},
                                     {5, "GMM_ROUTING_AREA_UPDATE_INITIATED"},
                                     {6, "GMM_SERVICE_REQUEST_INITIATED"},
                                     {7, "Unknown"},
                                     {255, "Unknown"}}));
INSTANTIATE_TEST_SUITE_P(ProcessPSSubState, ShownTextOf,
                         shownTexts("Process PS", 0x7130, 16, 14, "MM Sub State",
                                    {{0, "GMM_NORMAL_SERVICE"},
                                     {1, "GMM_LIMITED_SERVICE"},
                                     {2, "GMM_ATTACH_NEEDED"},
                                     {3, "GMM_ATTEMPTING_TO_ATTACH"},
                                     {4, "GMM_NO_IMSI"},
                                     {5, "GMM_NO_CELL_AVAILABLE"},
                                     {6, "GMM_PLMN_SEARCH"},
                                     {7, "GMM_SUSPENDED"},
                                     {8, "GMM_UPDATE_NEEDED"},
                                     {9, "GMM_ATTEMPING_TO_UPDATE"},
                                     {10, "GMM_ATTEMPTING_TO_UPDATE_MM"},
                                     {11, "GMM_IMSI_DETACH_INITIATED"},
                                     {12, "GMM_NULL_SUBSTATE"},
                                     {13, "Unknown"},
                                     {255, "Unknown"}}));
INSTANTIATE_TEST_SUITE_P(ProcessPSCause, ShownTextOf,
                         shownTexts("Process PS", 0x7130, 16, 15, "Attach Reject Cause",
                                    {{0, "GMM_GU1_UPDATED"},
                                     {1, "GMM_GU2_NOT_UPDATED"},
                                     {2, "GMM_GU3_PLMN_NOT_ALLOWED"},
                                     {3, "GMM_GU3_ROUTING_AREA_NOT_ALLOWED"},
                                     {4, "Unknown"},
                                     {255, "Unknown"}}));

} // namespace
} // namespace pelorus::test
