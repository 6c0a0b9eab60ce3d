#include "LogGenerator/C2K/PilotList.h"

#include "LogGenerator/Osprey/PackedText.h"

namespace pelorus {

PilotList::PilotList(const Dictionary* shownList) : shown(shownList)
{
    if (shown)
        list->reserve(shown->size());
    list->set(Label("_sorted"), "_sorted");
}

Dictionary::Entry PilotList::entryOf(std::size_t index, std::int64_t pn) const
{
    PackedText packed; // a byte's worth of pilots and 16 bits of PN: at most 9 characters
    packed.appendNumber(static_cast<std::uint32_t>(index));
    packed.append(';', 1);
    packed.appendNumber(static_cast<std::uint32_t>(pn));
    std::string key;
    packed.storeInto(key);
    if (shown && list->size() < shown->size()) {
        const auto& earlier = *(shown->begin() + static_cast<std::ptrdiff_t>(list->size()));
        if (earlier.key == key)
            return earlier;
    }
    return {Key(std::move(key)), {}};
}

} // namespace pelorus
