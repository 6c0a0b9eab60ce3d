#pragma once

#include <cstdint>
#include <random>

namespace pelorus {

/// The chance in a simulated life. Only the engine is the standard library's, whose numbers are laid down;
/// its distributions are not, and would make another life of the same seed with another library.
class Random {
public:
    explicit Random(std::uint64_t seed) : engine(seed) {}

    /// From 0 up to, but not including, 1.
    double uniform() { return static_cast<double>(engine() >> 11) * 0x1p-53; }
    double between(double low, double high) { return low + (high - low) * uniform(); }
    /// 0 to count - 1.
    std::uint32_t below(std::uint32_t count)
    {
        return static_cast<std::uint32_t>(((engine() >> 32) * count) >> 32);
    }
    bool chance(double probability) { return uniform() < probability; }
    /// Nearly normal, of mean 0 and deviation 1, and never beyond 3.5: the sum of four uniform numbers is
    /// cheap, and no level leaps out of this world.
    double normal()
    {
        const std::uint64_t bits = engine();
        const auto part = [bits](unsigned place) {
            return static_cast<std::int64_t>(bits >> place & 0xFFFF);
        };
        const std::int64_t sum = part(0) + part(16) + part(32) + part(48) - 131070;
        return static_cast<double>(sum) * (1.0 / 37837.227);
    }

private:
    std::mt19937_64 engine;
};

} // namespace pelorus
