#pragma once

#include <exception>

namespace pelorus {

/// A repeated record was asked for at an index that its list does not hold. Nothing catches it: a packet that
/// contradicts itself ends the program.
class ArrayOutOfBoundsException : public std::exception {
public:
    const char* what() const noexcept override { return "ArrayOutOfBoundsException"; }
};

} // namespace pelorus
