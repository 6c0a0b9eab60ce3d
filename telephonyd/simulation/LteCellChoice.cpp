#include "telephonyd/simulation/LteCellChoice.h"

#include "telephonyd/simulation/LteCellList.h"

namespace pelorus {

namespace {

// dB
constexpr double kReselectionHysteresis = 4.0; // Qhyst
constexpr double kGoodOfHigherPriority = 22.0; // ThreshX,High
constexpr double kPoorServing = 14.0;          // ThreshServing,Low
constexpr double kGoodOfLowerPriority = 18.0;  // ThreshX,Low
constexpr double kHandoverOffset = 3.0;        // of event A3
constexpr double kWornOut = 10.0;

/// The one with the best average among those that can be measured.
std::optional<std::size_t> best(const LteRadio& radio, std::size_t serving, std::size_t carrier)
{
    std::optional<std::size_t> found;
    for (const std::size_t cell : LteCellList(radio, serving, carrier, kLowestReportedRsrq))
        if (!found || radio[cell].averageRsrp > radio[*found].averageRsrp)
            found = cell;
    return found;
}

std::optional<std::size_t> betterByOffset(const LteRadio& radio, std::size_t serving, double offset)
{
    const auto neighbour = best(radio, serving, kLteCells[serving].carrier);
    if (neighbour && radio[*neighbour].averageRsrp > radio[serving].averageRsrp + offset)
        return neighbour;
    return std::nullopt;
}

} // namespace

double srxlev(const LteMeasurement& measured)
{
    return measured.averageRsrp - kLteQrxlevmin;
}

std::optional<std::size_t> reselectionTarget(const LteRadio& radio, std::size_t serving)
{
    const std::size_t own = kLteCells[serving].carrier;
    std::optional<std::size_t> lower;
    for (std::size_t carrier = 0; carrier < kLteCarrierCount; ++carrier) {
        const auto cell = carrier == own ? std::nullopt : best(radio, serving, carrier);
        if (!cell)
            continue;
        if (kLteCarriers[carrier].priority > kLteCarriers[own].priority) {
            if (srxlev(radio[*cell]) > kGoodOfHigherPriority)
                return cell;
        } else if (srxlev(radio[serving]) < kPoorServing && srxlev(radio[*cell]) > kGoodOfLowerPriority) {
            lower = cell;
        }
    }
    const auto neighbour = betterByOffset(radio, serving, kReselectionHysteresis);
    return neighbour ? neighbour : lower;
}

std::optional<std::size_t> handoverTarget(const LteRadio& radio, std::size_t serving)
{
    return betterByOffset(radio, serving, kHandoverOffset);
}

bool isWornOut(const LteRadio& radio, std::size_t serving)
{
    return srxlev(radio[serving]) < kWornOut && reselectionTarget(radio, serving).has_value();
}

} // namespace pelorus
