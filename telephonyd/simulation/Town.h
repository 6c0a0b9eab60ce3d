#pragma once

#include "telephonyd/simulation/Journey.h"

#include <array>

namespace pelorus {

/// The town that all handsets drive through: its base station sites, and a road past them.
constexpr std::size_t kSiteCount = 3;
extern const std::array<Point, kSiteCount> kSites;
extern const std::array<Point, 9> kRoad;

} // namespace pelorus
