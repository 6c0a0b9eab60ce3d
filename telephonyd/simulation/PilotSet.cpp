#include "telephonyd/simulation/PilotSet.h"

#include <algorithm>
#include <optional>

namespace pelorus {

namespace {

constexpr double kDropTime = 3.0;      // seconds, T_TDROP
constexpr double kClearlyBetter = 2.5; // dB, T_COMP

} // namespace

void PilotSet::reset(std::size_t sector)
{
    members[0] = {sector, 0};
    count = 1;
}

bool PilotSet::contains(std::size_t sector) const
{
    return std::any_of(members.begin(), members.begin() + static_cast<std::ptrdiff_t>(count),
                       [sector](const Member& member) { return member.sector == sector; });
}

std::size_t PilotSet::best(const CdmaCarrier& carrier) const
{
    std::size_t found = members[0].sector;
    for (std::size_t index = 1; index < count; ++index)
        if (carrier.averages[members[index].sector] > carrier.averages[found])
            found = members[index].sector;
    return found;
}

std::size_t PilotSet::worst(const CdmaCarrier& carrier) const
{
    std::size_t found = 0;
    for (std::size_t index = 1; index < count; ++index)
        if (carrier.averages[members[index].sector] < carrier.averages[members[found].sector])
            found = index;
    return found;
}

void PilotSet::remove(std::size_t index)
{
    std::move(members.begin() + static_cast<std::ptrdiff_t>(index) + 1,
              members.begin() + static_cast<std::ptrdiff_t>(count),
              members.begin() + static_cast<std::ptrdiff_t>(index));
    --count;
}

void PilotSet::dropWeak(const CdmaCarrier& carrier, double seconds)
{
    const std::size_t strongest = best(carrier);
    for (std::size_t index = count; index-- > 0;) {
        Member& member = members[index];
        member.weakFor = carrier.averages[member.sector] < thresholds.drop ? member.weakFor + seconds : 0;
        if (member.weakFor > kDropTime && member.sector != strongest)
            remove(index);
    }
}

void PilotSet::update(const CdmaCarrier& carrier, double seconds)
{
    dropWeak(carrier, seconds);
    std::optional<std::size_t> candidate;
    for (std::size_t sector = 0; sector < kCdmaSectorCount; ++sector)
        if (!contains(sector) && carrier.averages[sector] > thresholds.add &&
            (!candidate || carrier.averages[sector] > carrier.averages[*candidate]))
            candidate = sector;
    if (!candidate)
        return;
    if (count == kMost) {
        const std::size_t last = worst(carrier);
        if (carrier.averages[*candidate] < carrier.averages[members[last].sector] + kClearlyBetter)
            return;
        remove(last);
    }
    members[count++] = {*candidate, 0};
}

} // namespace pelorus
