#include "platform/PropertyList.h"
#include "tests/simulation/GsmWitness.h"

namespace pelorus::test {

void GsmWitness::seeCells(const SeenMessage& message)
{
    const Value list = parsePropertyList(message.bytes().subspan(13));
    ASSERT_TRUE(list.array());
    int servingCells = 0;
    for (const Value& element : list.array()->elements) {
        ASSERT_TRUE(element.dictionary());
        const Dictionary& cell = *element.dictionary();
        const auto number = [&cell](const char* key) { return signed32(cell.find(key)).value_or(-99999); };
        const auto isLevel = [this](int value, int lowest, int highest) {
            missingMeasurements += value == 32767;
            return value == 32767 || (value >= lowest && value <= highest);
        };
        const bool isUmts = *cell.at("CellMonitorCellRadioAccessTechnology").string() ==
                            "CellMonitorRadioAccessTechnologyUMTS";
        if (*cell.at("CellMonitorCellType").string() == "CellMonitorCellTypeServing") {
            ++servingCells;
            expect(number("CellMonitorMCC") == 1 && number("CellMonitorMNC") == 1, "network of the list");
            expect(number("CellMonitorLAC") == 4301 || number("CellMonitorLAC") == 4302, "LAC of the list");
            expect(number("CellMonitorCellId") > 0, "cell identity of the list");
            expect(isUmts ? number("CellMonitorUARFCN") == 10638 && number("CellMonitorSCN") > 0
                          : number("CellMonitorARFCN") > 0,
                   "channel of the list");
        } else if (isUmts) {
            expect(isLevel(number("CellMonitorRSCP"), -125, -40), "RSCP");
            expect(isLevel(number("CellMonitorECN0"), -24, -2), "Ec/N0");
            expect(number("CellMonitorUARFCN") == 10638 && number("CellMonitorSCN") > 0, "UMTS neighbour");
        } else {
            expect(isLevel(number("CellMonitorRSSI"), -55, -23), "RSSI in half dBm");
            expect(number("CellMonitorARFCN") > 0, "GSM neighbour");
        }
    }
    expect(servingCells == 1, "one serving cell");
}

} // namespace pelorus::test
