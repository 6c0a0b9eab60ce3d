#pragma once

#include <cstdint>
#include <mutex>

namespace pelorus {

/// The one lock of the section engine: recursive, process-wide, taken around whole-list replacement and
/// around the tree builder's walk over an array.
///
/// lockArray() acquires the recursive lock every time, unlockArray() releases it only when the depth is back
/// at 0 and then once: after nested use the lock stays held by that thread. This is meant; do not balance it.
class ArrayLock {
public:
    static void lockArray()
    {
        lock.lock();
        ++depth;
    }
    static void unlockArray()
    {
        if (--depth == 0)
            lock.unlock();
    }
    /// Whether another thread could take the lock now.
    static bool isFreeForOthers();

private:
    static std::recursive_mutex lock;
    static std::uint8_t depth; // wraps at 256
};

} // namespace pelorus
