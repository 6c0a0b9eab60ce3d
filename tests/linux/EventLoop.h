#pragma once

#include <QCoreApplication>
#include <QTimer>
#include <atomic>
#include <chrono>
#include <string>
#include <thread>

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

/// What a peer receives while the event loop runs.
template <class Peer> std::string receiveFrom(const Peer& peer, std::size_t length)
{
    std::atomic<bool> done = false;
    std::string received;
    std::thread reader([&] {
        received = peer.receive(length);
        done = true;
    });
    spinUntil([&] { return done.load(); }, std::chrono::minutes(1));
    reader.join();
    return received;
}

} // namespace pelorus::test
