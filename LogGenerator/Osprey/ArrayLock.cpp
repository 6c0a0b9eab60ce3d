#include "LogGenerator/Osprey/ArrayLock.h"

#include <thread>

namespace pelorus {

std::recursive_mutex ArrayLock::lock;
std::uint8_t ArrayLock::depth = 0;

bool ArrayLock::isFreeForOthers()
{
    bool taken = false;
    std::thread([&taken] {
        taken = lock.try_lock();
        if (taken)
            lock.unlock();
    }).join();
    return taken;
}

} // namespace pelorus
