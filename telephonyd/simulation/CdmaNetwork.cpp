#include "telephonyd/simulation/CdmaNetwork.h"

namespace pelorus {

// The sectors of a site are 168 pilots apart. The third site is a partner's: another system, another subnet,
// and the roaming light is on.
const std::array<CdmaSector, kCdmaSectorCount> kCdmaSectors = {{
    {0, 0.500, 0.866, 12, 2401, 4182, 18, 3, 0, 42},
    {0, 0.500, -0.866, 180, 2402, 4182, 18, 3, 0, 42},
    {0, -1.000, 0.000, 348, 2403, 4182, 18, 3, 0, 42},
    {1, -0.500, 0.866, 36, 2457, 4182, 18, 4, 0, 42},
    {1, -0.500, -0.866, 204, 2458, 4182, 18, 4, 0, 42},
    {1, 1.000, 0.000, 372, 2459, 4182, 18, 4, 0, 42},
    {2, 0.000, 1.000, 60, 11873, 4190, 2, 17, 1, 77},
    {2, 0.866, -0.500, 228, 11874, 4190, 2, 17, 1, 77},
    {2, -0.866, -0.500, 396, 11875, 4190, 2, 17, 1, 77},
}};

} // namespace pelorus
