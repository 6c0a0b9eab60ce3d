#pragma once

#include <functional>
#include <string>

namespace pelorus {

/// From now on the system log says (priority 3) which uncaught exception ends the program, before it aborts.
void reportUncaughtException();

/// What the program still does between that line and its end: called once with the exception's NAME, as in
/// "Recovered after NAME". An exception that leaves it is logged, and the program ends all the same. An empty
/// one clears it; do so before anything that it refers to goes.
void setLastWords(std::function<void(const std::string& name)> lastWords);

} // namespace pelorus
