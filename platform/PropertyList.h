#pragma once

#include "platform/Value.h"

#include <optional>
#include <span>
#include <string>
#include <vector>

namespace pelorus {

enum class PropertyListForm { xml, binary };

/// Bounds that no honest list reaches and no hostile one may pass.
struct PropertyListLimits {
    static constexpr std::size_t depth = 256;              // containers within containers
    static constexpr std::size_t values = 1'000'000;       // after shared references are expanded
    static constexpr std::size_t bytes = 64 * 1024 * 1024; // of text and data, after expansion
};

/// Reads a property list, binary ("bplist00") or XML. Nil for bytes that are no property list, are cut short,
/// or pass the limits; `why`, if given, then gets one line that says so. Memory stays within a small multiple
/// of the limits whatever the bytes are.
Value parsePropertyList(std::span<const std::byte> bytes, std::string* why = nullptr);

/// Nothing when the value is nil or holds a nil somewhere.
std::optional<std::vector<std::byte>> serializePropertyList(const Value& value,
                                                            PropertyListForm form = PropertyListForm::xml);

} // namespace pelorus
