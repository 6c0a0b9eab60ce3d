#pragma once

#include "LogGenerator/C2K/NumberText.h"
#include "platform/Value.h"

namespace pelorus {

/// Pilots and their strengths as a row shows them, in the order of their records: "index;PN" to a text, and
/// the mark that makes the display sort them.
class PilotList {
public:
    /// `shown` is the list that the row has: its keys and texts are used again where they stay the same. May
    /// be null.
    explicit PilotList(const Dictionary* shown);

    /// A pilot with the PN of record `index`, 8 and 16 bits wide. `origin` says what the strength is made
    /// from; `strength(text)` writes it, and is not called when it is there already.
    template <class Write> void add(std::size_t index, std::int64_t pn, Value::Origin origin, Write strength)
    {
        Dictionary::Entry pilot = entryOf(index, pn);
        if (!pilot.value.isMadeFrom(origin)) {
            strength(pilot.value.text());
            pilot.value.setOrigin(origin);
        }
        list->append(std::move(pilot.key), std::move(pilot.value));
    }
    bool empty() const { return list->size() == 1; }
    const std::shared_ptr<Dictionary>& dictionary() const { return list; }

private:
    Dictionary::Entry entryOf(std::size_t index, std::int64_t pn) const;

    const Dictionary* shown;
    std::shared_ptr<Dictionary> list = makeDictionary();
};

} // namespace pelorus
