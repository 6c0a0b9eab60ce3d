#include "telephonyd/modem/AccessTechnology.h"

#include <utility>

namespace pelorus {

namespace {

constexpr std::uint32_t bits(unsigned first, unsigned last)
{
    return ((std::uint32_t{2} << last) - 1) & ~((std::uint32_t{1} << first) - 1);
}

// MMModemAccessTechnology.
constexpr std::uint32_t kGsm = bits(1, 4);                  // GSM to EDGE
constexpr std::uint32_t kUmts = bits(5, 9);                 // UMTS to HSPA+
constexpr std::uint32_t kLte = bits(14, 14) | bits(16, 17); // LTE, Cat-M and NB-IoT
constexpr std::uint32_t kAny = 0xFFFFFFFF;                  // as good as unknown
// MMModemCapability.
constexpr std::uint32_t kAbleToGsmUmts = 4;
constexpr std::uint32_t kAbleToLte = 8;
constexpr std::uint32_t kAbleTo5G = 64;
// MMModemMode.
constexpr std::pair<std::uint32_t, const char*> kModes[] = {{16, "5G"}, {8, "LTE"}, {4, "UMTS"}, {2, "GSM"}};

} // namespace

CellKind servingKind(std::uint32_t accessTechnologies)
{
    if (accessTechnologies == kAny)
        return CellKind::none;
    if ((accessTechnologies & kLte) != 0)
        return CellKind::lte;
    if ((accessTechnologies & kUmts) != 0)
        return CellKind::umts;
    return (accessTechnologies & kGsm) != 0 ? CellKind::gsm : CellKind::none;
}

std::string technologyOn(CellKind kind)
{
    switch (kind) {
    case CellKind::lte:
        return "Osprey LTE";
    case CellKind::umts:
    case CellKind::gsm:
        return "Osprey GSM";
    case CellKind::none:
        break;
    }
    return {};
}

std::string technologyAbleTo(std::uint32_t capabilities)
{
    if ((capabilities & (kAbleToLte | kAbleTo5G)) != 0)
        return technologyOn(CellKind::lte);
    return technologyOn((capabilities & kAbleToGsmUmts) != 0 ? CellKind::gsm : CellKind::none);
}

std::string modesText(std::uint32_t modes)
{
    std::string text;
    for (const auto& [bit, name] : kModes)
        if (modes != kAny && (modes & bit) != 0)
            text += (text.empty() ? "" : ", ") + std::string(name);
    return text;
}

} // namespace pelorus
