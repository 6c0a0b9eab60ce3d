#include "telephonyd/server/TerminationSignals.h"

#include <QSocketNotifier>
#include <csignal>
#include <sys/signalfd.h>

namespace pelorus {

namespace {

sigset_t terminationSignals()
{
    sigset_t signals;
    sigemptyset(&signals);
    sigaddset(&signals, SIGINT);
    sigaddset(&signals, SIGTERM);
    return signals;
}

} // namespace

TerminationSignals::TerminationSignals(std::function<void()> callback)
{
    const sigset_t signals = terminationSignals();
    pthread_sigmask(SIG_BLOCK, &signals, nullptr);
    descriptor = FileDescriptor(::signalfd(-1, &signals, SFD_CLOEXEC | SFD_NONBLOCK));
    notifier = std::make_unique<QSocketNotifier>(descriptor.get(), QSocketNotifier::Read);
    QObject::connect(notifier.get(), &QSocketNotifier::activated, notifier.get(),
                     [this, callback = std::move(callback)] {
                         signalfd_siginfo signal;
                         while (::read(descriptor.get(), &signal, sizeof signal) > 0)
                             ;
                         callback();
                     });
}

TerminationSignals::~TerminationSignals()
{
    notifier.reset();
    const sigset_t signals = terminationSignals();
    pthread_sigmask(SIG_UNBLOCK, &signals, nullptr);
}

} // namespace pelorus
