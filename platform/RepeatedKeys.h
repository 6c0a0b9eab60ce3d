#pragma once

#include "platform/Value.h"

#include <memory>

namespace pelorus {

/// The dictionary, or one in its place where keys are repeated: those keep the first one's place and the last
/// one's value. Takes no quadratic time, whatever the number of keys.
std::shared_ptr<Dictionary> withoutRepeatedKeys(std::shared_ptr<Dictionary> dictionary);

} // namespace pelorus
