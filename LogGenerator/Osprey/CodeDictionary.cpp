#include "LogGenerator/Osprey/CodeDictionary.h"

#include <algorithm>
#include <charconv>

namespace pelorus {

CodeDictionary::Subscribers& CodeDictionary::operator[](std::string_view decimalCode)
{
    LogCode code = 0;
    std::from_chars(decimalCode.data(), decimalCode.data() + decimalCode.size(), code);
    const auto found = std::find_if(entries.begin(), entries.end(),
                                    [code](const Entry& entry) { return entry.code == code; });
    return found != entries.end() ? found->subscribers : entries.emplace_back(Entry{code, {}}).subscribers;
}

std::vector<std::string> CodeDictionary::allKeys() const
{
    std::vector<std::string> keys;
    for (const Entry& entry : entries)
        keys.push_back(std::to_string(entry.code));
    return keys;
}

} // namespace pelorus
