#pragma once

#include <QCoreApplication>
#include <QTimer>
#include <chrono>

namespace pelorus::test {

/// Runs the event loop until the condition holds. False when it does not within the (generous) time.
template <class Condition>
bool spinUntil(Condition condition, std::chrono::milliseconds limit = std::chrono::seconds(20))
{
    const auto deadline = std::chrono::steady_clock::now() + limit;
    QTimer heartbeat; // for conditions that another thread or process makes true
    heartbeat.start(std::chrono::milliseconds(5));
    while (!condition()) {
        if (std::chrono::steady_clock::now() > deadline)
            return false;
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    return true;
}

/// Lets everything happen that is due now.
inline void spinOnce()
{
    bool done = false;
    QTimer::singleShot(20, Qt::PreciseTimer, QCoreApplication::instance(), [&done] { done = true; });
    spinUntil([&done] { return done; });
}

} // namespace pelorus::test
