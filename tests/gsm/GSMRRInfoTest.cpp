#include "LogGenerator/Osprey/GSM/GSMRRInfo.h"
#include "tests/gsm/Packets.h"
#include "tests/gsm/ShownText.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

TEST(GSMRRInfo, ShowsEveryRowInTableOrder)
{
    SectionFixture<GSMRRInfo> section(makeDictionary());
    section.receive(0x512C, gsmState());
    section.receive(0x5137, gsmMeasurement());
    section.receive(0x5072, discontinuousTransmission());
    section.receive(0x51F6, gprsTimers());
    EXPECT_EQ(section.shown(), "RR State: RR_IDLE\n"
                               "RR Sub State: 77\n"
                               "RR Status: 88\n"
                               "RR Mode: Data\n"
                               "Serving Rx Level: 190\n"
                               "Rx Quality Full: -65504\n" // 0xFFFF0020, the whole word
                               "Rx Quality Sub: 131070\n"
                               "DTX Used: ON\n"
                               "DRX Used: 60 sec\n");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>GSMRRInfo", "<4>GSMRRInfo", "<4>GSMRRInfo", "<4>GSMRRInfo"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x512C, 0x5137, 0x5072, 0x51F6));
}

INSTANTIATE_TEST_SUITE_P(GSMRRInfoState, ShownTextOf,
                         shownTexts("GSM RR Info", 0x512C, 17, 13, "RR State",
                                    {{0, "RR_INACTIVE"},
                                     {1, "RR_GOING_ACTIVE"},
                                     {2, "RR_GOING_INACTIVE"},
                                     {3, "RR_CELL_SELECTION"},
                                     {4, "RR_PLMN_LIST_CONSTRUCTION"},
                                     {5, "RR_IDLE"},
                                     {6, "RR_CELL_RESELECTION"},
                                     {7, "RR_CONNECTION_PENDING"},
                                     {8, "RR_CHOOSE_CELL"},
                                     {9, "RR_DATA_TRANSFER"},
                                     {10, "RR_NO_CHANNELS"},
                                     {11, "RR_CONNECTION_RELEASE"},
                                     {12, "RR_EARLY_CAMPED_WAIT_FOR_SI"},
                                     {13, "RR_W2G_INTERRAT_HANDOVER_ PROGRESS"},
                                     {14, "RR_W2G_INTERRAT_RESELECTION_PROGRESS"},
                                     {15, "RR_WAIT_FOR_EARLY_PSCAN"},
                                     {16, "GRR51"},
                                     {17, "GRR52"},
                                     {18, "RR_G2W_INTERRAT_RESELECTION_PROGRESS"},
                                     {19, "RR_G2W_INTERRAT_HANDOVER_ PROGRESS"},
                                     {20, "RR_CELL_REEST"},
                                     {21, "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS"},
                                     {22, "Unknown"},
                                     {255, "Unknown"}}));
INSTANTIATE_TEST_SUITE_P(GSMRRInfoMode, ShownTextOf,
                         shownTexts("GSM RR Info", 0x512C, 17, 16, "RR Mode",
                                    {{0, "Voice"}, {1, "Data"}, {255, "Data"}}));
INSTANTIATE_TEST_SUITE_P(GSMRRInfoTransmission, ShownTextOf,
                         shownTexts("GSM RR Info", 0x5072, 20, 19, "DTX Used",
                                    {{0, "OFF"}, {1, "ON"}, {255, "ON"}}));
INSTANTIATE_TEST_SUITE_P(GSMRRInfoTimer, ShownTextOf,
                         shownTexts("GSM RR Info", 0x51F6, 24, 16, "DRX Used",
                                    {{0, "0 sec"}, {255, "255 sec"}}));

} // namespace
} // namespace pelorus::test
