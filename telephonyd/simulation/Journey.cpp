#include "telephonyd/simulation/Journey.h"

#include <algorithm>
#include <cmath>

namespace pelorus {

namespace {

constexpr double kUsualSpeed = 9.0; // metres a second, town traffic
constexpr double kSpeedDeviation = 3.5;
constexpr double kPaceMemory = 25.0;     // seconds
constexpr double kSecondsPerStop = 70.0; // between two lights, on average
constexpr double kLongestStop = 30.0;    // seconds
constexpr double kStartSpread = 0.999;

double distance(Point a, Point b)
{
    return std::sqrt((a.x - b.x) * (a.x - b.x) + (a.y - b.y) * (a.y - b.y));
}

} // namespace

Journey::Journey(std::span<const Point> road, Random& random)
    : corners(road.begin(), road.end()), where(corners.front()), pace(random)
{
    if (random.chance(0.5))
        std::reverse(corners.begin() + 1, corners.end());
    double length = distance(corners.back(), corners.front());
    for (std::size_t corner = 1; corner < corners.size(); ++corner)
        length += distance(corners[corner - 1], corners[corner]);
    move(length * kStartSpread * random.uniform());
    lastMove = 0;
}

double Journey::speed(double seconds, Random& random)
{
    pace.advance(Fading(seconds, kPaceMemory), random);
    if (standing > 0) {
        standing -= seconds;
        return 0;
    }
    if (random.chance(seconds / kSecondsPerStop))
        standing = kLongestStop * random.uniform();
    return std::max(1.0, kUsualSpeed + kSpeedDeviation * pace.now());
}

void Journey::advance(double seconds, Random& random)
{
    lastMove = speed(seconds, random) * seconds;
    move(lastMove);
}

void Journey::move(double metres)
{
    while (true) {
        const Point ahead = corners[next];
        const double left = distance(where, ahead);
        if (metres < left) {
            where.x += (ahead.x - where.x) * metres / left;
            where.y += (ahead.y - where.y) * metres / left;
            return;
        }
        metres -= left;
        where = ahead;
        next = (next + 1) % corners.size();
    }
}

} // namespace pelorus
