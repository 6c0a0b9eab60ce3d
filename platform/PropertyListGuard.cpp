#include "platform/PropertyListGuard.h"

#include <fmt/format.h>

namespace pelorus {

bool PropertyListBudget::takeValues(std::uint64_t count, std::string& why)
{
    if (count > values) {
        why = fmt::format("the property list holds more than {} values", PropertyListLimits::values);
        return false;
    }
    values -= count;
    return true;
}

bool PropertyListBudget::takeBytes(std::uint64_t count, std::string& why)
{
    if (count > bytes) {
        why = fmt::format("the property list expands by more than {} bytes of text and data",
                          PropertyListLimits::expansion);
        return false;
    }
    bytes -= count;
    return true;
}

bool PropertyListBudget::takeSteps(std::uint64_t count, std::string& why)
{
    if (count > steps) {
        why = "the XML property list has too many keys in one dictionary or entities in one text";
        return false;
    }
    steps -= count;
    return true;
}

bool PropertyListBudget::takePaths(std::uint64_t count, std::uint64_t length, std::string& why)
{
    if (length > 0 && count > paths / length) {
        why = fmt::format("the property list has more than {} bytes of paths", PropertyListLimits::paths);
        return false;
    }
    paths -= count * length;
    return true;
}

bool PropertyListBudget::allowsDepth(std::size_t containers, std::string& why)
{
    if (containers <= PropertyListLimits::depth)
        return true;
    why = fmt::format("the property list nests deeper than {} containers", PropertyListLimits::depth);
    return false;
}

} // namespace pelorus
