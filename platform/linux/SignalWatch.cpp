#include "platform/linux/SignalWatch.h"

#include <QSocketNotifier>
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
    pthread_sigmask(SIG_BLOCK, &set, &before);
    descriptor = FileDescriptor(signalfd(-1, &set, SFD_NONBLOCK | SFD_CLOEXEC));
    notifier = std::make_unique<QSocketNotifier>(descriptor.get(), QSocketNotifier::Read);
    QObject::connect(notifier.get(), &QSocketNotifier::activated, [this] { deliver(); });
}

SignalWatch::~SignalWatch()
{
    notifier.reset();
    pthread_sigmask(SIG_SETMASK, &before, nullptr);
}

void SignalWatch::deliver()
{
    signalfd_siginfo information{};
    while (read(descriptor.get(), &information, sizeof information) == sizeof information)
        received(static_cast<int>(information.ssi_signo));
}

} // namespace pelorus
