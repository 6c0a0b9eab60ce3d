#pragma once

#include "telephonyd/simulation/Drift.h"

#include <cstddef>
#include <span>
#include <vector>

namespace pelorus {

/// Metres east and north.
struct Point {
    double x = 0;
    double y = 0;
};

/// A handset on its way round and round a closed road, in traffic: it starts somewhere on it, drives faster
/// and slower, and stops at lights.
class Journey {
public:
    Journey(std::span<const Point> road, Random& random);

    void advance(double seconds, Random& random);
    Point position() const { return where; }
    /// Metres driven in the last advance().
    double moved() const { return lastMove; }

private:
    double speed(double seconds, Random& random);
    void move(double metres);

    std::vector<Point> corners;
    std::size_t next = 1; // the corner ahead
    Point where;
    Drift pace;
    double standing = 0; // seconds until the lights change
    double lastMove = 0;
};

} // namespace pelorus
