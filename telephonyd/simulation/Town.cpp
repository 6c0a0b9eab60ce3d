#include "telephonyd/simulation/Town.h"

namespace pelorus {

const std::array<Point, kSiteCount> kSites = {{{0, 0}, {980, 150}, {430, 900}}};

const std::array<Point, 9> kRoad = {{
    {120, -260},
    {620, -220},
    {1150, -120},
    {1230, 320},
    {800, 480},
    {760, 1000},
    {350, 1240},
    {60, 820},
    {-280, 240},
}};

} // namespace pelorus
