#include "LogGenerator/Osprey/ListRewriter.h"

namespace pelorus {

void ListRewriter::clear(Array& list)
{
    // From the end, so that each record finds its own rows again, which often show the same.
    for (auto element = list.elements.rbegin(); element != list.elements.rend(); ++element)
        if (auto rows = element->takeDictionary(); rows && rows.use_count() == 1)
            spare.push_back(std::move(rows));
    elements.clear();
    Base::clearElementsInArray(list);
}

std::shared_ptr<Dictionary> ListRewriter::freshRows()
{
    if (spare.empty())
        return makeDictionary();
    auto rows = std::move(spare.back());
    spare.pop_back();
    return rows;
}

} // namespace pelorus
