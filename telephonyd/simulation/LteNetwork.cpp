#include "telephonyd/simulation/LteNetwork.h"

namespace pelorus {

// A wide layer everywhere, and a narrower one above it that is preferred but does not reach as far.
const std::array<LteCarrier, kLteCarrierCount> kLteCarriers = {{
    {.earfcn = 1850, .band = 3, .resourceBlocks = 100, .priority = 5, .extraLoss = 0.0},
    {.earfcn = 3100, .band = 7, .resourceBlocks = 50, .priority = 6, .extraLoss = 5.0},
}};

// Three sectors a site, whose physical identities differ modulo 3. The third site lies in the next tracking
// area.
const std::array<LteCell, kLteCellCount> kLteCells = {{
    {0, 0, 30, 0.500, 0.866, 0x1870501, 4301, 2, 0, 1204},
    {0, 0, 31, 0.500, -0.866, 0x1870502, 4301, 2, 0, 1204},
    {0, 0, 32, -1.000, 0.000, 0x1870503, 4301, 2, 0, 1204},
    {0, 1, 210, -0.500, 0.866, 0x1870601, 4301, 2, 388, 250911},
    {0, 1, 211, -0.500, -0.866, 0x1870602, 4301, 2, 388, 250911},
    {0, 1, 212, 1.000, 0.000, 0x1870603, 4301, 2, 388, 250911},
    {0, 2, 396, 0.000, 1.000, 0x18A1201, 4302, 2, 771, 90377},
    {0, 2, 397, 0.866, -0.500, 0x18A1202, 4302, 2, 771, 90377},
    {0, 2, 398, -0.866, -0.500, 0x18A1203, 4302, 2, 771, 90377},
    {1, 0, 48, 0.500, 0.866, 0x1870511, 4301, 4, 0, 1204},
    {1, 1, 229, -0.500, 0.866, 0x1870611, 4301, 4, 388, 250911},
    {1, 2, 414, 0.000, -1.000, 0x18A1211, 4302, 4, 771, 90377},
}};

} // namespace pelorus
