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
    /// The dictionary at a place among the elements, or a spare or new one put there.
    Dictionary& rowsAt(std::size_t place);
    /// Takes the elements from a place on out of the list in the making.
    void spareFrom(std::size_t place);

    std::vector<Value> spare;    // dictionaries that nobody else holds
    std::vector<Value> elements; // of the list in the making; empty in between, kept for its memory
};

template <class Fill> void ListRewriter::rewriteRows(Array& list, std::size_t count, Fill fill)
{
    Base::clearElementsInArray(list, elements);
    std::size_t kept = 0;
    for (std::size_t index = 0; index < count; ++index) {
        RowWriter rows(rowsAt(kept));
        if (fill(index, rows))
            ++kept;
    }
    spareFrom(kept);
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
