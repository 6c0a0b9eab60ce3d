#include "telephonyd/simulation/UtranNetwork.h"

namespace pelorus {

// Sectors of a site on different frequencies. The third site lies in the next location area.
const std::array<UtranCell, kUtranCellCount> kUtranCells = {{
    {0, 0.500, 0.866, 10055, 8, 0x2B10121, 4301, 1},
    {0, 0.500, -0.866, 10063, 21, 0x2B10122, 4301, 1},
    {0, -1.000, 0.000, 10071, 40, 0x2B10123, 4301, 1},
    {1, -0.500, 0.866, 10055, 64, 0x2B10161, 4301, 2},
    {1, -0.500, -0.866, 10063, 77, 0x2B10162, 4301, 2},
    {1, 1.000, 0.000, 10071, 96, 0x2B10163, 4301, 2},
    {2, 0.000, 1.000, 10055, 103, 0x2B10201, 4302, 3},
    {2, 0.866, -0.500, 10063, 112, 0x2B10202, 4302, 3},
    {2, -0.866, -0.500, 10071, 125, 0x2B10203, 4302, 3},
}};

} // namespace pelorus
