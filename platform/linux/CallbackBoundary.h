#pragma once

#include <utility>

namespace pelorus {

/// Calls what the program handed to the event loop. An exception must not unwind through Qt's frames: here it
/// ends the program.
template <class Function, class... Arguments>
decltype(auto) callAtBoundary(const Function& function, Arguments&&... arguments) noexcept
{
    return function(std::forward<Arguments>(arguments)...);
}

} // namespace pelorus
