#include "LogGenerator/C2K/OneXActiveSet.h"

#include "LogGenerator/C2K/LogCode_0x119C.h"
#include "LogGenerator/C2K/PilotList.h"

#include <cmath>

namespace pelorus {

namespace {

using Layout = LogCode_0x119C::ActiveSet;

constexpr NumberText kStrength = "%+.2f dB";
constexpr NumberText kReferenceStrength = "(ref pilot) %+.2f dB";
constexpr double kWeakest = 0.00001; // -50 dB

/// What all pilots of one packet share.
struct Scale {
    std::int64_t a;
    std::int64_t b;
    std::int64_t c;
};

/// Ec/Io in dB.
double activeSetStrength(const Scale& scale, std::int64_t energy)
{
    if (scale.a == 0 || scale.b == 0)
        return 10 * std::log10(kWeakest);
    const auto a = static_cast<double>(scale.a);
    const auto b = static_cast<double>(scale.b);
    const double signal = std::ldexp(static_cast<double>(energy), static_cast<int>(2 * scale.c - 3));
    return 10 * std::log10(std::max(signal / (9 * a * a * b) - 1 / a, kWeakest));
}

} // namespace

std::shared_ptr<Dictionary> oneXActiveSet(PacketView activeSet, const Dictionary* shown)
{
    const Scale scale{activeSet.padded(Layout::a), activeSet.padded(Layout::b), activeSet.padded(Layout::c)};
    const auto count = static_cast<std::size_t>(activeSet.padded(Layout::pilotCount));
    const auto k = static_cast<std::uint32_t>(activeSet.padded(Layout::k));
    const std::int64_t reference = activeSet.padded(Layout::referencePn);
    const Records records = Layout::pilots(k);
    PilotList pilots(shown);
    for (std::size_t index = 0; index < count; ++index) {
        const PacketView pilot(activeSet.from(records.start + index * records.stride));
        const std::int64_t pn = pilot.padded(Layout::pn);
        const std::int64_t energy = pilot.padded(Layout::energy(k));
        const NumberText& format = pn == reference ? kReferenceStrength : kStrength;
        const std::int64_t madeFrom = scale.a | scale.b << 16 | scale.c << 24 | energy << 32;
        pilots.add(index, pn, {&format, madeFrom},
                   [&](std::string& text) { format.write(text, activeSetStrength(scale, energy)); });
    }
    return pilots.dictionary();
}

} // namespace pelorus
