#pragma once

#include "platform/PropertyList.h"

namespace pelorus::fuzz {

/// That the value, if it can be written in that form, is read back equal, and written again as the same
/// bytes.
void checkReadBack(const Value& value, PropertyListForm form);

/// As ==, and a NaN is equal to a NaN.
bool isSame(const Value& a, const Value& b);

} // namespace pelorus::fuzz
