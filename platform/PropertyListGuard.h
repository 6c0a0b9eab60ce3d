#pragma once

#include "platform/PropertyList.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace pelorus {

// What stands in front of libplist 2.2.0, which recurses once for every container and takes much that is
// malformed for something else. Nothing reaches libplist that did not pass here.

/// What is left of PropertyListLimits while a list is walked.
class PropertyListBudget {
public:
    /// For a list of so many bytes.
    explicit PropertyListBudget(std::size_t length) : bytes(length + PropertyListLimits::expansion) {}

    /// False when the limit is passed; `why` then says which.
    bool takeValues(std::uint64_t count, std::string& why);
    bool takeBytes(std::uint64_t count, std::string& why);
    bool takeSteps(std::uint64_t count, std::string& why);
    /// For so many values in a container whose own path is so long.
    bool takePaths(std::uint64_t count, std::uint64_t length, std::string& why);
    static bool allowsDepth(std::size_t containers, std::string& why);

private:
    std::size_t values = PropertyListLimits::values;
    std::uint64_t bytes;
    std::uint64_t steps = PropertyListLimits::steps;
    std::uint64_t paths = PropertyListLimits::paths;
};

/// Property lists count time from here.
constexpr Date kReferenceDate = std::chrono::sys_days{std::chrono::year{2001} / 1 / 1};
/// The years 0 to 9999, counted so.
constexpr std::chrono::seconds kEarliestDate{-63'145'526'400};
constexpr std::chrono::seconds kLatestDate{252'423'993'599};

/// The text of the root value's element, which is all that libplist needs to see of an XML list. Nothing,
/// with one line in `why`, when libplist must not read it.
std::optional<std::string_view> admitXmlPropertyList(std::string_view text, std::string& why);

} // namespace pelorus
