#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "tests/support/SectionFixture.h"
#include "tests/support/TemplateFixture.h"

#include <gmock/gmock.h>
#include <map>

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;

class C2KTemplate : public testing::Test {
protected:
    TemplateFixture<C2KLogGenerator> fixture{"C2KTemplate"};
};

/// How often each text stands in a template, by the text.
void collectTexts(const Value& node, std::map<std::string, int>& counts)
{
    if (node.string())
        ++counts[*node.string()];
    else if (const Dictionary* group = node.dictionary())
        for (const auto& entry : *group)
            collectTexts(entry.value, counts);
    else
        ++counts["neither group nor text"];
}

TEST_F(C2KTemplate, ShowsEveryKeyOnceAndNoOther)
{
    std::map<std::string, int> counts;
    collectTexts(fixture.pattern(), counts);
    EXPECT_EQ(counts["_sorted"], 11);
    counts.erase("_sorted");
    std::vector<std::string> keys;
    for (const auto& [key, count] : counts) {
        EXPECT_EQ(count, 1) << key;
        keys.push_back(key);
    }
    EXPECT_THAT(keys, testing::UnorderedElementsAre(
                          "kChannel", "k1xEVDODeviceState", "kBandClass", "kRxAGC0", "kRxAGC1", "kTxAGC",
                          "kServingPNOffset", "kSessionState", "kUATI24", "kColorCode", "kActiveSetPilots",
                          "kFingerC2I", "kFLDataRate", "kRLDataRate", "k1xDeviceState", "k1xRx0BandClass",
                          "k1xRx0ChanNum", "k1xRxAGC0", "k1xRx1BandClass", "k1xRx1ChanNum", "k1xRxAGC1",
                          "k1xTxAGC", "k1xActiveSetInfo", "k1xTrafficFER", "k1xRoamingHome", "kSystemId",
                          "kNetworkId", "kPacketZoneId", "kBaseId", "kProtocolRevision"));
}

TEST_F(C2KTemplate, HasEVDOAnd1xSideBySideInAnOrderOfItsOwn)
{
    EXPECT_THAT(fixture.labels(fixture.pattern()), ElementsAre("_sorted", "01;EV-DO", "02;1x"));
    const Value evdo = fixture.valueOf(fixture.pattern(), "01;EV-DO");
    EXPECT_THAT(fixture.labels(evdo),
                ElementsAre("_sorted", "01;State", "02;RF", "03;Pilots", "04;Data Rates"));
    const Value oneX = fixture.valueOf(fixture.pattern(), "02;1x");
    EXPECT_THAT(fixture.labels(oneX), ElementsAre("_sorted", "01;State", "02;RF", "03;Pilots", "04;System"));
    EXPECT_THAT(fixture.fileText(), Not(HasSubstr("DOCTYPE")));
}

TEST_F(C2KTemplate, RowsFillWithTheirPackets)
{
    fixture.receive(0x1183, PacketBuilder(50).u16(13, 0x0819).u8(36, 2));
    fixture.receive(0x12B6, PacketBuilder(37).u8(15, 1).u16(25, 132).u16(27, 512));
    fixture.receive(0x127E, PacketBuilder(1750));
    fixture.receive(0x127E, PacketBuilder(1750).u8(14, 1));
    EXPECT_EQ(textOf(fixture.shown("01;EV-DO")), "_sorted: _sorted\n"
                                                 "01;State:\n"
                                                 "  _sorted: _sorted\n"
                                                 "  01;Device State: Sync [2]\n"
                                                 "  02;Session State: Closed [0]\n"
                                                 "  03;UATI24: 0x000000\n"
                                                 "  04;Color Code: 0\n"
                                                 "02;RF:\n"
                                                 "  _sorted: _sorted\n"
                                                 "  01;Band Class: 1.8 to 2.0GHz PCS band [1]\n"
                                                 "  02;Channel: 25\n"
                                                 "  03;Rx0 AGC: +0 dBm\n"
                                                 "  04;Rx1 AGC: N/A\n"
                                                 "  05;Tx AGC: N/A\n"
                                                 "03;Pilots:\n"
                                                 "  _sorted: _sorted\n"
                                                 "  01;Serving PN Offset: 0 × 64chips\n"
                                                 "  02;Active Set:\n"
                                                 "    _sorted: _sorted\n"
                                                 "    0;132: +0.00 dB\n"
                                                 "  03;Finger C/I: \n"
                                                 "04;Data Rates:\n"
                                                 "  _sorted: _sorted\n"
                                                 "  01;Forward Link: \n"
                                                 "  02;Reverse Link: 0.00 kbps\n");
}

} // namespace
} // namespace pelorus::test
