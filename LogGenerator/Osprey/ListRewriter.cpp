#include "LogGenerator/Osprey/ListRewriter.h"

namespace pelorus {

void ListRewriter::clear(Array& list)
{
    Base::clearElementsInArray(list, elements);
    spareFrom(0);
}

Dictionary& ListRewriter::rowsAt(std::size_t place)
{
    if (place == elements.size())
        elements.emplace_back();
    Value& element = elements[place];
    if (Dictionary* const own = element.unsharedDictionary()) [[likely]]
        return *own;
    if (spare.empty()) {
        element = makeDictionary();
    } else {
        element = std::move(spare.back());
        spare.pop_back();
    }
    return *element.dictionary();
}

void ListRewriter::spareFrom(std::size_t place)
{
    // From the end, so that each record finds its own rows again, which often show the same.
    for (std::size_t index = elements.size(); index > place; --index)
        if (elements[index - 1].unsharedDictionary())
            spare.push_back(std::move(elements[index - 1]));
    elements.resize(place);
}

} // namespace pelorus
