#include "telephonyd/simulation/IfxSections.h"

#include "telephonyd/simulation/Units.h"

#include <algorithm>
#include <fmt/format.h>

namespace pelorus {

namespace {

constexpr std::size_t kMostNeighbours = 6;
constexpr double kLowestIdentified = -86.0; // dBm, where the BSIC is read
constexpr double kLowestEcio = -12.0;       // dB, FDD_Qmin
constexpr double kLowestAccess = -104.0;    // dBm, RXLEV_ACCESS_MIN
constexpr double kMetresPerAdvance = 553.5; // half of what light travels in a symbol
// Power control levels of GSM 900 (3GPP TS 45.005, 4.1.1): 2 dB each, from 33 dBm down.
constexpr int kLoudest = 5;
constexpr int kSoftest = 19;
constexpr double kLoudestBelow = -88.0; // dBm received

std::string number(std::int64_t value)
{
    return fmt::format("{}", value);
}

std::string dBm(double level)
{
    return fmt::format("{} dBm", rounded(level));
}

/// Network and base station colour code.
std::string colourCode(const GsmCell& cell)
{
    return fmt::format("{}-{}", cell.colourCode >> 3, cell.colourCode & 7);
}

int timingAdvance(const IfxConnection& connection)
{
    return static_cast<int>(connection.metres / kMetresPerAdvance);
}

int powerLevel(double level)
{
    return std::clamp(kLoudest + rounded((level - kLoudestBelow) / 2.0), kLoudest, kSoftest);
}

} // namespace

std::shared_ptr<Dictionary> ifxServingCell(const GsmRadio& radio, std::size_t serving)
{
    const GsmCell& cell = kGsmCells[serving];
    const double level = radio.average(serving);
    const int criterion = rounded(level - kLowestAccess);
    return makeDictionary(
        {{"PLMN", makeDictionary({{"Network", "001 01"}})},
         {"Location",
          makeDictionary({{"LAC", number(cell.locationArea)}, {"RAC", number(cell.routingArea)}})},
         {"Cell ID", number(cell.cellIdentity)},
         {"Channel", makeDictionary({{"ARFCN", number(cell.arfcn)}})},
         {"Band", "GSM 900"},
         {"BSIC", colourCode(cell)},
         {"RxLev", makeDictionary({{"Average", dBm(level)}, {"Last", dBm(radio.level(serving))}})},
         {"Selection",
          makeDictionary({{"C1", number(criterion)}, {"C2", number(criterion + cell.reselectOffset)}})}});
}

std::shared_ptr<Array> ifxNeighbours(const GsmRadio& radio, std::size_t serving)
{
    auto list = makeArray({"GSM Neighbors"});
    for (const std::size_t cell : radio.neighbours(serving, kMostNeighbours)) {
        if (radio.average(cell) < kLowestIdentified)
            break;
        list->elements.emplace_back(
            makeDictionary({{"ARFCN", number(kGsmCells[cell].arfcn)},
                            {"BSIC", colourCode(kGsmCells[cell])},
                            {"RxLev", makeDictionary({{"Average", dBm(radio.average(cell))}})}}));
    }
    return list;
}

std::shared_ptr<Array> ifxUmtsCells(const UmtsRadio& radio)
{
    auto list = makeArray({"UMTS Neighbors"});
    for (std::size_t cell = 0; cell < kUmtsCellCount; ++cell)
        if (radio.isDetected(cell) && radio[cell].averageEcio > kLowestEcio)
            list->elements.emplace_back(
                makeDictionary({{"Channel", makeDictionary({{"UARFCN", number(kUmtsUarfcn)}})},
                                {"Scrambling Code", number(kUmtsCells[cell].scramblingCode)},
                                {"RSCP", dBm(radio[cell].averageRscp)},
                                {"Ec/N0", fmt::format("{:.1f} dB", radio[cell].averageEcio)}}));
    return list->elements.size() > 1 ? list : nullptr;
}

std::shared_ptr<Dictionary> ifxRadioResource(std::string_view state, bool hasService)
{
    return makeDictionary(
        {{"RR", makeDictionary({{"State", state}})}, {"Service", hasService ? "Normal" : "None"}});
}

std::shared_ptr<Dictionary> ifxDedicatedChannel(const IfxConnection& connection)
{
    const GsmCell& cell = kGsmCells[connection.serving];
    auto frequencies = makeArray({"Mobile Allocation"});
    for (const std::uint16_t arfcn : cell.hoppingChannels)
        frequencies->elements.emplace_back(number(arfcn));
    return makeDictionary(
        {{"Type", "TCH/F"},
         {"Timeslot", number(static_cast<std::int64_t>(2 + connection.serving % 4))},
         {"Hopping", makeDictionary({{"HSN", number(cell.hoppingSequence)}, {"Frequencies", frequencies}})},
         {"RxQual", number(connection.quality)},
         {"Timing Advance", number(timingAdvance(connection))},
         {"Tx Power Level", makeDictionary({{"Ordered", number(powerLevel(connection.level))}})}});
}

std::shared_ptr<Dictionary> ifxPacketTransfer(const IfxConnection& connection)
{
    const int scheme = std::clamp(4 - connection.quality / 2, 1, 4);
    return makeDictionary({{"Timeslots", makeDictionary({{"Downlink", "3"}, {"Uplink", "1"}})},
                           {"Coding", makeDictionary({{"Scheme", fmt::format("CS-{}", scheme)}})},
                           {"Timing Advance", number(timingAdvance(connection))}});
}

} // namespace pelorus
