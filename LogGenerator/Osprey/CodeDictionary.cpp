#include "LogGenerator/Osprey/CodeDictionary.h"

#include <charconv>

namespace pelorus {

CodeDictionary::Subscribers& CodeDictionary::operator[](std::string_view decimalCode)
{
    LogCode code = 0;
    std::from_chars(decimalCode.data(), decimalCode.data() + decimalCode.size(), code);
    std::uint8_t& place = places[placeOf(code)];
    if (place == 0) {
        entries.push_back({code, {}});
        place = static_cast<std::uint8_t>(entries.size());
    }
    return entries[place - 1].subscribers;
}

std::vector<std::string> CodeDictionary::allKeys() const
{
    std::vector<std::string> keys;
    for (const Entry& entry : entries)
        keys.push_back(std::to_string(entry.code));
    return keys;
}

} // namespace pelorus
