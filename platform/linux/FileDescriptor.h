#pragma once

#include <unistd.h>
#include <utility>

namespace pelorus {

/// Closes a file descriptor when it goes. One below 0 is none.
class FileDescriptor {
public:
    explicit FileDescriptor(int descriptor = -1) : descriptor(descriptor) {}
    FileDescriptor(FileDescriptor&& other) noexcept : descriptor(other.release()) {}
    FileDescriptor& operator=(FileDescriptor&& other) noexcept
    {
        std::swap(descriptor, other.descriptor);
        return *this;
    }
    ~FileDescriptor()
    {
        if (descriptor >= 0)
            ::close(descriptor);
    }

    explicit operator bool() const { return descriptor >= 0; }
    int get() const { return descriptor; }
    int release() { return std::exchange(descriptor, -1); }
    /// For those who must know whether the last bytes arrived.
    bool close() { return ::close(release()) == 0; }

private:
    int descriptor;
};

} // namespace pelorus
