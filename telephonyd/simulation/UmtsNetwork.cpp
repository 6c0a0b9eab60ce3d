#include "telephonyd/simulation/UmtsNetwork.h"

namespace pelorus {

// The third site has none: around it the handset falls back to GSM.
const std::array<UmtsCell, kUmtsCellCount> kUmtsCells = {{
    {0, 0.500, 0.866, 121, 0x2A1C4E1, 4301, 1, 257},
    {0, 0.500, -0.866, 122, 0x2A1C4E2, 4301, 1, 257},
    {0, -1.000, 0.000, 123, 0x2A1C4E3, 4301, 1, 257},
    {1, -0.500, 0.866, 305, 0x2A1C5A1, 4301, 2, 258},
    {1, -0.500, -0.866, 306, 0x2A1C5A2, 4301, 2, 258},
    {1, 1.000, 0.000, 307, 0x2A1C5A3, 4301, 2, 258},
}};

} // namespace pelorus
