#include "platform/linux/LinuxMessagePort.h"

#include <utility>

namespace pelorus {

void LinuxMessagePort::invalidate()
{
    if (std::exchange(invalidated, true))
        return;
    const auto self = shared_from_this(); // the callback may release the port
    deliverArrived();
    close();
    if (const auto callback = std::exchange(invalidation, nullptr))
        callback(*this);
}

} // namespace pelorus
