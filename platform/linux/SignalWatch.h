#pragma once

#include <QObject>
#include <functional>
#include <initializer_list>
#include <memory>

class QSocketNotifier;

namespace pelorus {

/// Delivers signals on the event loop, where anything may be done about them.
class SignalWatch {
public:
    SignalWatch(std::initializer_list<int> signals, std::function<void(int signal)> callback);
    ~SignalWatch();
    SignalWatch(const SignalWatch&) = delete;
    SignalWatch& operator=(const SignalWatch&) = delete;

private:
    void deliver();

    std::function<void(int)> received;
    int descriptor = -1;
    std::unique_ptr<QSocketNotifier> notifier;
};

} // namespace pelorus
