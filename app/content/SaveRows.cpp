#include "app/content/SaveRows.h"

namespace pelorus {

std::vector<std::string> saveRowTexts(const std::shared_ptr<Array>& saveHistory)
{
    std::vector<std::string> texts;
    if (!saveHistory)
        return texts;
    for (const Value& entry : saveHistory->elements) {
        const Value description = entry.dictionary() ? entry.dictionary()->at("Description") : Value();
        texts.push_back(description.string() ? *description.string() : std::string());
    }
    return texts;
}

} // namespace pelorus
