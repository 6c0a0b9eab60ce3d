#pragma once

#include <functional>
#include <string>

namespace pelorus {

/// Takes one line for whoever runs the server, without its line feed.
using Report = std::function<void(const std::string& line)>;

} // namespace pelorus
