#pragma once

#include "platform/linux/FileDescriptor.h"

#include <csignal>
#include <functional>
#include <initializer_list>
#include <memory>

class QSocketNotifier;

namespace pelorus {

/// Delivers signals on the event loop, where anything may be done about them, also those that come before it
/// runs. Make it before any thread starts; when it goes, the signals do what they did before.
class SignalWatch {
public:
    SignalWatch(std::initializer_list<int> signals, std::function<void(int signal)> callback);
    ~SignalWatch();
    SignalWatch(const SignalWatch&) = delete;
    SignalWatch& operator=(const SignalWatch&) = delete;

private:
    void deliver();

    std::function<void(int)> received;
    sigset_t before{}; // the signals that were blocked
    FileDescriptor descriptor;
    std::unique_ptr<QSocketNotifier> notifier;
};

} // namespace pelorus
