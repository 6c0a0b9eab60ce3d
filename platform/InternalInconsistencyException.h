#pragma once

#include <stdexcept>
#include <string>
#include <string_view>

namespace pelorus {

/// An assertion that did not hold, with the place that the assertion names.
class InternalInconsistencyException : public std::logic_error {
public:
    InternalInconsistencyException(const std::string& text, std::string_view method, std::string_view file,
                                   int line)
        : std::logic_error(text), method(method), file(file), line(line)
    {}

    const std::string_view method; // literals
    const std::string_view file;
    const int line;
};

} // namespace pelorus
