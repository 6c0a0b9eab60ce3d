#pragma once

#include <cstddef>
#include <cstdint>
#include <random>
#include <vector>

namespace pelorus::bench {

/// What a CDMA2000 handset logs while it has a 1x call and an EV-DO session: of 100 messages 40 are frames of
/// the traffic channel, 15 each the fingers and the active set of EV-DO, 15 the state of 1x, 8 the EV-DO
/// summary, 3 each the counters of the two links, 1 the system. Levels and energies change with every
/// message.
class CdmaMix {
public:
    std::vector<std::byte> next()
    {
        const unsigned kind = step++ % 100;
        if (kind % 5 < 2)
            return trafficFrame();
        if (kind % 20 < 5)
            return pilots(0x12B6, 25, 15, 12, 2);
        if (kind % 20 < 10)
            return pilots(0x108A, 23, 22, 14, 6);
        if (kind % 20 < 15)
            return oneXState();
        switch (kind) {
        case 17:
        case 37:
        case 57:
            return counters(0x1192, 241, 13, 17);
        case 18:
        case 38:
        case 58:
            return counters(0x127E, 1750, 14, 18);
        case 77:
            return system();
        default:
            return summary();
        }
    }

private:
    using Packet = std::vector<std::byte>;

    static Packet packet(unsigned code, std::size_t length)
    {
        Packet bytes(length);
        put(bytes, 0, 1, 1);
        put(bytes, 1, 2, static_cast<std::uint32_t>(length - 1));
        put(bytes, 3, 2, code);
        return bytes;
    }
    static void put(Packet& bytes, std::size_t place, std::size_t width, std::uint32_t value)
    {
        for (std::size_t index = 0; index < width; ++index)
            bytes[place + index] = static_cast<std::byte>(value >> (8 * index));
    }
    std::uint32_t random(std::uint32_t low, std::uint32_t high)
    {
        return low + static_cast<std::uint32_t>(generator()) % (high - low + 1);
    }

    Packet trafficFrame()
    {
        Packet bytes = packet(0x119D, 17 + 28);
        put(bytes, 14, 1, 1);
        put(bytes, 17, 1, 11);
        put(bytes, 19, 2, 28);
        put(bytes, 17 + 24, 1, random(0, 99) < 2 ? 1 : 0);
        return bytes;
    }
    Packet pilots(unsigned code, std::size_t start, std::size_t countPlace, std::size_t stride,
                  std::size_t energyPlace)
    {
        Packet bytes = packet(code, start + 5 * stride);
        put(bytes, countPlace, 1, 5);
        for (std::uint32_t pilot = 0; pilot < 5; ++pilot) {
            put(bytes, start + pilot * stride, 2, 12 * pilot + 4);
            put(bytes, start + pilot * stride + energyPlace, 2, random(20, 500));
        }
        return bytes;
    }
    Packet oneXState()
    {
        constexpr std::uint32_t kPilots = 4;
        constexpr std::uint32_t kActiveSetSize = 12 + kPilots * 20;
        Packet bytes = packet(0x119C, 17 + 8 + 16 + kActiveSetSize + 8);
        put(bytes, 14, 1, 4);
        std::size_t place = 17;
        const auto subpacket = [&](std::uint32_t identifier, std::uint32_t size) {
            put(bytes, place, 1, identifier);
            put(bytes, place + 2, 2, size);
            return place += size, place - size;
        };
        put(bytes, subpacket(1, 8) + 4, 1, 8);
        const std::size_t radio = subpacket(2, 16);
        put(bytes, radio + 6, 2, 384);
        put(bytes, radio + 8, 2, 384);
        put(bytes, radio + 10, 1, random(0, 255));
        put(bytes, radio + 11, 1, random(0, 255));
        put(bytes, radio + 12, 2, random(0, 200));
        const std::size_t activeSet = subpacket(3, kActiveSetSize);
        put(bytes, activeSet + 4, 2, 8);
        put(bytes, activeSet + 6, 1, 4);
        put(bytes, activeSet + 7, 1, 3);
        put(bytes, activeSet + 8, 1, kPilots);
        put(bytes, activeSet + 9, 1, 1);
        put(bytes, activeSet + 10, 2, 132);
        for (std::uint32_t pilot = 0; pilot < kPilots; ++pilot) {
            put(bytes, activeSet + 12 + 20 * pilot, 2, 132 + 12 * pilot);
            put(bytes, activeSet + 12 + 20 * pilot + 16, 2, random(40, 250));
        }
        subpacket(4, 8);
        return bytes;
    }
    Packet summary()
    {
        Packet bytes = packet(0x1183, 50);
        put(bytes, 13, 2, 0x0819);
        for (std::size_t level = 15; level < 18; ++level)
            put(bytes, level, 1, random(160, 200));
        put(bytes, 18, 2, 132);
        put(bytes, 36, 2, 0x0405);
        put(bytes, 38, 4, 0x2A012345);
        return bytes;
    }
    Packet counters(unsigned code, std::size_t length, std::size_t sequencePlace, std::size_t start)
    {
        Packet bytes = packet(code, length);
        put(bytes, sequencePlace, 4, step);
        for (std::size_t place = start; place + 4 <= length; place += 4)
            put(bytes, place, 4, step + random(0, 1));
        return bytes;
    }
    static Packet system()
    {
        Packet bytes = packet(0x134F, 190);
        put(bytes, 13, 1, 2);
        put(bytes, 46, 4, 2);
        put(bytes, 50, 4, 0x00091004);
        put(bytes, 133, 1, 6);
        put(bytes, 184, 2, 1234);
        return bytes;
    }

    std::mt19937 generator{1}; // NOLINT(cert-msc51-cpp): repeatable on purpose
    std::uint32_t step = 0;
};

} // namespace pelorus::bench
