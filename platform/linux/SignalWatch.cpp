#include "platform/linux/SignalWatch.h"

#include <QSocketNotifier>
#include <csignal>
#include <sys/signalfd.h>
#include <unistd.h>

namespace pelorus {

SignalWatch::SignalWatch(std::initializer_list<int> signals, std::function<void(int signal)> callback)
    : received(std::move(callback))
{
    sigset_t set;
    sigemptyset(&set);
    for (const int signal : signals)
        sigaddset(&set, signal);
    sigprocmask(SIG_BLOCK, &set, nullptr);
    descriptor = signalfd(-1, &set, SFD_NONBLOCK | SFD_CLOEXEC);
    notifier = std::make_unique<QSocketNotifier>(descriptor, QSocketNotifier::Read);
    QObject::connect(notifier.get(), &QSocketNotifier::activated, [this] { deliver(); });
}

SignalWatch::~SignalWatch()
{
    notifier.reset();
    close(descriptor);
}

void SignalWatch::deliver()
{
    signalfd_siginfo information{};
    while (read(descriptor, &information, sizeof information) == sizeof information)
        received(static_cast<int>(information.ssi_signo));
}

} // namespace pelorus
