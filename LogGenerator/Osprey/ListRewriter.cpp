#include "LogGenerator/Osprey/ListRewriter.h"

namespace pelorus {

void ListRewriter::clear(Array& list)
{
    for (Value& element : list.elements)
        if (auto rows = element.takeDictionary(); rows && rows.use_count() == 1)
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
