#include "telephonyd/modem/ModemCells.h"

#include <fmt/format.h>
#include <gmock/gmock.h>

namespace pelorus {

namespace {

/// Key and value in order, without what every key begins with.
std::string shown(const Value& cell)
{
    constexpr std::string_view kPrefix = "CellMonitor";
    std::string text;
    if (!cell)
        return "nothing";
    for (const auto& [key, value] : *cell.dictionary()) {
        const std::string said = value.string()    ? value.string()->substr(kPrefix.size())
                                 : value.integer() ? std::to_string(*value.integer())
                                                   : "?";
        text += fmt::format("{}{}={}", text.empty() ? "" : " ", key.text().substr(kPrefix.size()), said);
    }
    return text;
}

std::vector<std::string> shownList(const Value& list)
{
    std::vector<std::string> cells;
    for (const Value& cell : list.array()->elements)
        cells.push_back(shown(cell));
    return cells;
}

QVariantMap lteServing()
{
    return {{"cell-type", 5U}, {"serving", true},       {"operator-id", "26201"}, {"tac", "2B0C"},
            {"ci", "124A30B"}, {"physical-ci", "1A0"},  {"earfcn", 1300U},        {"rsrp", -95.4},
            {"rsrq", -10.5},   {"timing-advance", 12U}, {"bandwidth", 20U}};
}

ServingCellFacts lteFacts()
{
    ServingCellFacts facts;
    facts.kind = CellKind::lte;
    facts.location = ThreeGppLocation::parse("262,01,0,124A30B,2B0C");
    facts.operatorCode = OperatorCode::parse("26201");
    facts.signal = {{"rsrp", -95.0}, {"rsrq", -10.0}, {"rssi", -65.0}};
    return facts;
}

using testing::ElementsAre;

} // namespace

TEST(ModemCells, LteCellWithItsHexadecimalIdentities)
{
    EXPECT_EQ(shown(cellOf(lteServing())),
              "CellRadioAccessTechnology=RadioAccessTechnologyLTE CellType=CellTypeServing MCC=262 MNC=1 "
              "TAC=11020 CellId=19178251 PID=416 BandInfo=3 UARFCN=1300 RSCP=-95 ECN0=-11");
}

TEST(ModemCells, LteNeighbourMarksWhatWasNotMeasured)
{
    EXPECT_EQ(
        shown(cellOf({{"cell-type", 5U}, {"physical-ci", "1F7"}, {"earfcn", 6300U}, {"rsrp", -101.0}})),
        "CellRadioAccessTechnology=RadioAccessTechnologyLTE CellType=CellTypeNeighbor PID=503 BandInfo=20 "
        "UARFCN=6300 RSCP=-101 ECN0=32767");
}

TEST(ModemCells, GsmCellsInHalfDecibels)
{
    EXPECT_EQ(shown(cellOf({{"cell-type", 2U},
                            {"serving", true},
                            {"operator-id", "310410"},
                            {"lac", "31C5"},
                            {"ci", "F7CD"},
                            {"arfcn", 62U},
                            {"base-station-id", "2A"},
                            {"rx-level", 40U}})),
              "CellRadioAccessTechnology=RadioAccessTechnologyGSM CellType=CellTypeServing MCC=310 MNC=410 "
              "LAC=12741 CellId=63437 ARFCN=62 RSSI=-35");
    EXPECT_EQ(
        shown(cellOf({{"cell-type", 2U}, {"arfcn", 1023U}, {"rx-level", 0U}})),
        "CellRadioAccessTechnology=RadioAccessTechnologyGSM CellType=CellTypeNeighbor ARFCN=1023 RSSI=-55");
    EXPECT_EQ(
        shown(cellOf({{"cell-type", 2U}, {"arfcn", 975U}})),
        "CellRadioAccessTechnology=RadioAccessTechnologyGSM CellType=CellTypeNeighbor ARFCN=975 RSSI=32767");
}

TEST(ModemCells, UmtsCells)
{
    EXPECT_EQ(
        shown(cellOf({{"cell-type", 3U},
                      {"serving", true},
                      {"operator-id", "00101"},
                      {"lac", "1"},
                      {"ci", "83f7cd"},
                      {"uarfcn", 10562U},
                      {"psc", 511U},
                      {"rscp", -80.0},
                      {"ecio", -7.5},
                      {"path-loss", 100U}})),
        "CellRadioAccessTechnology=RadioAccessTechnologyUMTS CellType=CellTypeServing MCC=1 MNC=1 LAC=1 "
        "CellId=8648653 UARFCN=10562 SCN=511 RSCP=-80 ECN0=-8");
    EXPECT_EQ(
        shown(cellOf({{"cell-type", 3U}, {"uarfcn", 10562U}, {"psc", 0U}})),
        "CellRadioAccessTechnology=RadioAccessTechnologyUMTS CellType=CellTypeNeighbor UARFCN=10562 SCN=0 "
        "RSCP=32767 ECN0=32767");
}

TEST(ModemCells, ValuesThatCannotBeAreLeftOut)
{
    EXPECT_EQ(shown(cellOf({{"cell-type", 5U},
                            {"serving", true},
                            {"operator-id", "2620"},
                            {"tac", "FFFE"},
                            {"ci", "FFFFFFFF"},
                            {"physical-ci", "1F8"}, // 504
                            {"earfcn", 262144U},
                            {"rsrp", std::nan("")},
                            {"rsrq", -1e9}})),
              "CellRadioAccessTechnology=RadioAccessTechnologyLTE CellType=CellTypeServing");
    EXPECT_EQ(shown(cellOf({{"cell-type", 5U},
                            {"serving", true},
                            {"ci", "0x12"},
                            {"tac", "12 "},
                            {"physical-ci", 416U}, // a number where text belongs
                            {"earfcn", -1},
                            {"rsrp", "-95"},
                            {"operator-id", "26A01"}})),
              "CellRadioAccessTechnology=RadioAccessTechnologyLTE CellType=CellTypeServing");
    EXPECT_EQ(shown(cellOf({{"cell-type", 2U}, {"arfcn", 1024U}, {"rx-level", 64U}})),
              "CellRadioAccessTechnology=RadioAccessTechnologyGSM CellType=CellTypeNeighbor RSSI=32767");
}

TEST(ModemCells, OfOtherTechnologiesAreNotShown)
{
    for (const unsigned type : {0U, 1U, 4U, 6U, 7U, 0xFFFFFFFFU})
        EXPECT_FALSE(cellOf({{"cell-type", type}, {"serving", true}, {"ci", "1"}})) << type;
    EXPECT_FALSE(cellOf({{"cell-type", "5"}}));
    EXPECT_FALSE(cellOf({}));
}

TEST(ModemCells, ServingLteCellWithoutCellInfo)
{
    EXPECT_EQ(shown(servingCell(lteFacts())),
              "CellRadioAccessTechnology=RadioAccessTechnologyLTE CellType=CellTypeServing MCC=262 MNC=1 "
              "TAC=11020 CellId=19178251 RSCP=-95 ECN0=-10 RSSI=-33");
}

TEST(ModemCells, ServingLteCellOfAModemThatTellsTheAreaUnderItsOlderName)
{
    ServingCellFacts facts = lteFacts();
    facts.location = ThreeGppLocation::parse("001,01,31C5,83F7CD,0");
    facts.signal.clear();
    facts.bands = {1U, 5U, 33U}; // 900 MHz, UMTS band 1, LTE band 3
    EXPECT_EQ(
        shown(servingCell(facts)),
        "CellRadioAccessTechnology=RadioAccessTechnologyLTE CellType=CellTypeServing MCC=1 MNC=1 TAC=12741 "
        "CellId=8648653 BandInfo=3");
    facts.bands.append(50U); // band 20 as well: it may be in either
    EXPECT_EQ(servingCell(facts).dictionary()->find("CellMonitorBandInfo"), nullptr);
}

TEST(ModemCells, ServingGsmAndUmtsCellsWithoutCellInfo)
{
    ServingCellFacts facts;
    facts.kind = CellKind::gsm;
    facts.location = ThreeGppLocation::parse("310,410,31C5,F7CD");
    facts.signal = {{"rssi", -71.0}, {"error-rate", 0.0}};
    EXPECT_EQ(shown(servingCell(facts)), "CellRadioAccessTechnology=RadioAccessTechnologyGSM "
                                         "CellType=CellTypeServing MCC=310 MNC=410 LAC=12741 "
                                         "CellId=63437 RSSI=-36");
    facts.kind = CellKind::umts;
    facts.signal = {{"rscp", -82.0}, {"ecio", -6.0}};
    EXPECT_EQ(shown(servingCell(facts)), "CellRadioAccessTechnology=RadioAccessTechnologyUMTS "
                                         "CellType=CellTypeServing MCC=310 MNC=410 LAC=12741 "
                                         "CellId=63437 RSCP=-82 ECN0=-6");
}

TEST(ModemCells, OperatorStandsInForALocationThatIsRefused)
{
    ServingCellFacts facts = lteFacts();
    facts.location = {};
    facts.signal.clear();
    EXPECT_EQ(shown(servingCell(facts)),
              "CellRadioAccessTechnology=RadioAccessTechnologyLTE CellType=CellTypeServing MCC=262 MNC=1");
}

TEST(ModemCells, ThereIsNoServingCellOffTheNetwork)
{
    ServingCellFacts facts = lteFacts();
    facts.kind = CellKind::none;
    EXPECT_FALSE(servingCell(facts));
    facts = ServingCellFacts{CellKind::lte, {}, {}, {{"rsrp", -95.0}}, {}};
    EXPECT_FALSE(servingCell(facts));
    EXPECT_THAT(shownList(cellMonitorList({}, facts)), ElementsAre());
}

TEST(ModemCells, CellInfoWinsAndItsGapsAreFilledFromTheSameCell)
{
    QVariantMap serving = lteServing();
    serving["rsrp"] = -91.0;
    serving.remove("tac");
    serving.remove("rsrq");
    const QVariantMap neighbour = {{"cell-type", 2U}, {"arfcn", 62U}, {"rx-level", 10U}};
    EXPECT_THAT(
        shownList(cellMonitorList({neighbour, QVariantMap{{"cell-type", 6U}}, 5, serving}, lteFacts())),
        ElementsAre(
            "CellRadioAccessTechnology=RadioAccessTechnologyLTE CellType=CellTypeServing MCC=262 MNC=1 "
            "CellId=19178251 PID=416 BandInfo=3 UARFCN=1300 RSCP=-91 TAC=11020 ECN0=-10 RSSI=-33",
            "CellRadioAccessTechnology=RadioAccessTechnologyGSM CellType=CellTypeNeighbor ARFCN=62 "
            "RSSI=-50"));
}

TEST(ModemCells, GapsAreNotFilledFromAnotherCell)
{
    QVariantMap serving = lteServing();
    serving.remove("tac");
    serving["ci"] = "124A30C";
    EXPECT_EQ(shown(cellMonitorList({serving}, lteFacts()).array()->elements.at(0)),
              "CellRadioAccessTechnology=RadioAccessTechnologyLTE CellType=CellTypeServing MCC=262 MNC=1 "
              "CellId=19178252 PID=416 BandInfo=3 UARFCN=1300 RSCP=-95 ECN0=-11");
}

TEST(ModemCells, NoMoreThan128)
{
    const QVariantMap neighbour = {{"cell-type", 2U}, {"arfcn", 62U}};
    EXPECT_EQ(cellMonitorList(QVariantList(5000, neighbour), {}).array()->elements.size(), 128U);
}

TEST(ModemCells, NeighboursAloneComeBehindTheServingCellThatIsKnown)
{
    const QVariantMap neighbour = {{"cell-type", 3U}, {"uarfcn", 10562U}, {"psc", 7U}, {"rscp", -99.0}};
    EXPECT_THAT(shownList(cellMonitorList({neighbour}, lteFacts())),
                ElementsAre(testing::HasSubstr("TAC=11020"),
                            "CellRadioAccessTechnology=RadioAccessTechnologyUMTS CellType=CellTypeNeighbor "
                            "UARFCN=10562 SCN=7 RSCP=-99 ECN0=32767"));
}

} // namespace pelorus
