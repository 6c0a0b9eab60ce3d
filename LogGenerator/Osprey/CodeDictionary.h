#pragma once

#include "LogGenerator/Osprey/LogPacket.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pelorus {

class Base;

/// Section name to section. Sections are owned by their index.
using ClassDictionary = std::unordered_map<std::string, Base*>;

/// Log code to the sections that subscribed to it, in subscription order. The keys are decimal texts
/// ("45250", "16711681"); packets, which come by the hundred thousand, look the number up.
class CodeDictionary {
public:
    using Subscribers = std::vector<Base*>;

    /// The list under a decimal text, made when it is absent.
    Subscribers& operator[](std::string_view decimalCode);
    /// nullptr when nobody subscribed.
    const Subscribers* find(LogCode code) const
    {
        const std::size_t place = places[placeOf(code)];
        return place == 0 ? nullptr : &entries[place - 1].subscribers;
    }
    std::vector<std::string> allKeys() const;

private:
    struct Entry {
        LogCode code;
        Subscribers subscribers;
    };
    /// A number of its own for each of the codes that there can be.
    static std::size_t placeOf(LogCode code)
    {
        return (code & 0xFFFF) | (code >= kInternalCodes ? 0x10000U : 0U);
    }

    std::vector<Entry> entries;                                            // a few dozen at most
    std::vector<std::uint8_t> places = std::vector<std::uint8_t>(0x20000); // of the entries, from 1; 0: none
};

} // namespace pelorus
