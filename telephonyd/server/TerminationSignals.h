#pragma once

#include "platform/linux/FileDescriptor.h"

#include <functional>
#include <memory>

class QSocketNotifier;

namespace pelorus {

/// Turns SIGINT and SIGTERM into a callback on the event loop, also those that come before it runs. Make it
/// before any thread starts; when it goes, the signals do what they did before.
class TerminationSignals {
public:
    explicit TerminationSignals(std::function<void()> callback);
    ~TerminationSignals();
    TerminationSignals(const TerminationSignals&) = delete;
    TerminationSignals& operator=(const TerminationSignals&) = delete;

private:
    FileDescriptor descriptor;
    std::unique_ptr<QSocketNotifier> notifier;
};

} // namespace pelorus
