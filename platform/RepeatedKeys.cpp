#include "platform/RepeatedKeys.h"

#include <algorithm>
#include <limits>
#include <span>
#include <vector>

namespace pelorus {

namespace {

/// The entries' positions, sorted by key and equal keys by position.
std::vector<std::size_t> sortedByKey(const Dictionary& dictionary)
{
    std::vector<std::size_t> order(dictionary.size());
    for (std::size_t i = 0; i < order.size(); ++i)
        order[i] = i;
    const std::span entries(dictionary.begin(), dictionary.end());
    std::sort(order.begin(), order.end(), [entries](std::size_t a, std::size_t b) {
        const int difference = entries[a].key.text().compare(entries[b].key.text());
        return difference != 0 ? difference < 0 : a < b;
    });
    return order;
}

bool mayRepeatKeys(const Dictionary& dictionary)
{
    if (dictionary.size() > 32)
        return true;
    for (auto entry = dictionary.begin(); entry != dictionary.end(); ++entry)
        for (auto other = dictionary.begin(); other != entry; ++other)
            if (entry->key == other->key)
                return true;
    return false;
}

} // namespace

std::shared_ptr<Dictionary> withoutRepeatedKeys(std::shared_ptr<Dictionary> dictionary)
{
    if (!mayRepeatKeys(*dictionary))
        return dictionary;
    const std::vector<std::size_t> order = sortedByKey(*dictionary);
    const std::span entries(dictionary->begin(), dictionary->end());
    constexpr std::size_t none = std::numeric_limits<std::size_t>::max();
    std::vector<std::size_t> valueFrom(order.size(), none);
    std::size_t count = 0;
    for (std::size_t i = 0; i < order.size(); ++count) {
        const std::size_t first = order[i];
        std::size_t last = first;
        for (; i < order.size() && entries[order[i]].key == entries[first].key; ++i)
            last = order[i];
        valueFrom[first] = last;
    }
    if (count == order.size())
        return dictionary;
    auto unique = makeDictionary();
    unique->reserve(count);
    for (std::size_t i = 0; i < valueFrom.size(); ++i)
        if (valueFrom[i] != none)
            unique->append(entries[i].key, entries[valueFrom[i]].value);
    return unique;
}

} // namespace pelorus
