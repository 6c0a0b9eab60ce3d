#pragma once

#include "LogGenerator/Osprey/Base.h"
#include "LogGenerator/Osprey/Row.h"

#include <vector>

namespace pelorus {

/// Fills lists anew, whole, in the memory of what they held before: a section rewrites its lists with every
/// packet, and seldom with more rows than the last time.
class ListRewriter {
public:
    /// Empties the list. Row dictionaries that nobody else holds are kept to be filled again.
    void clear(Array& list);
    /// Makes it a list of up to `count` dictionaries; `fill(index, rows)` writes the rows of each and says
    /// whether it is kept.
    template <class Fill> void rewriteRows(Array& list, std::size_t count, Fill fill);
    /// Makes it a list of `count` texts; `fill(index, text)` writes each.
    template <class Fill> void rewriteTexts(Array& list, std::size_t count, Fill fill);

private:
    std::shared_ptr<Dictionary> freshRows();

    std::vector<std::shared_ptr<Dictionary>> spare;
    std::vector<Value> elements; // of the list in the making; empty in between, kept for its memory
};

template <class Fill> void ListRewriter::rewriteRows(Array& list, std::size_t count, Fill fill)
{
    clear(list);
    if (count == 0)
        return;
    std::shared_ptr<Dictionary> dictionary;
    for (std::size_t index = 0; index < count; ++index) {
        if (!dictionary)
            dictionary = freshRows();
        RowWriter rows(*dictionary);
        if (fill(index, rows))
            elements.emplace_back(std::move(dictionary));
    }
    if (dictionary)
        spare.push_back(std::move(dictionary));
    Base::replaceArray(list, elements);
}

template <class Fill> void ListRewriter::rewriteTexts(Array& list, std::size_t count, Fill fill)
{
    elements.resize(count);
    for (std::size_t index = 0; index < count; ++index)
        fill(index, elements[index].text());
    Base::replaceArray(list, elements);
}

} // namespace pelorus
