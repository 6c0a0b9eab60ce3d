#pragma once

#include "platform/Platform.h"

namespace pelorus {

/// What local and remote ports have in common: they become invalid once, and then say so once.
class LinuxMessagePort : public MessagePort, public std::enable_shared_from_this<LinuxMessagePort> {
public:
    virtual bool isValid() const = 0;
    void setInvalidationCallback(PortInvalidationCallback callback) { invalidation = std::move(callback); }
    /// Delivers what arrived, closes the port and calls the callback, if this is the first time.
    void invalidate();

protected:
    virtual void deliverArrived() {}
    virtual void close() = 0;
    bool isInvalidated() const { return invalidated; }

private:
    PortInvalidationCallback invalidation;
    bool invalidated = false;
};

} // namespace pelorus
