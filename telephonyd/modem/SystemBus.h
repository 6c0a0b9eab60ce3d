#pragma once

#include "telephonyd/modem/SignalRelay.h"

#include <QDBusConnection>
#include <QTimer>
#include <chrono>
#include <memory>
#include <optional>
#include <string>

namespace pelorus {

/// A connection to the system bus that is made anew when it is lost. Nothing waits for anything: connecting
/// is done by another thread, since the library does not return before the bus has answered.
class SystemBus {
public:
    struct MethodCall {
        QString service;
        QString path;
        QString interface;
        QString method;
        QVariantList arguments = {};
    };
    using Reply = std::function<void(const QDBusMessage& reply)>; // or error

    /// `address` is empty for the system's own bus.
    SystemBus(QString address, std::chrono::milliseconds retry);
    ~SystemBus();
    SystemBus(const SystemBus&) = delete;
    SystemBus& operator=(const SystemBus&) = delete;

    struct Callbacks {
        std::function<void()> connected;
        std::function<void(const std::string& why)> lost; // or not reached; it goes on trying
    };
    void open(Callbacks callbacks);

    /// A reply comes once, in the form of an error after the time; not at all when the bus was lost
    /// meanwhile.
    void call(const MethodCall& call, std::chrono::milliseconds timeout, Reply reply);
    struct Subscription {
        QString service = {}; // empty for any: who must be sure looks at the message
        QString path = {};    // empty for any
        QString interface;
        QString signal;
        QStringList firstArguments = {};
    };
    std::unique_ptr<SignalRelay> subscribe(const Subscription& wanted, SignalRelay::Callback callback);

private:
    void connect();
    void takeConnection();
    void lose(const std::string& why);

    QString address;
    QString name; // of the connection, within the process
    Callbacks callbacks;
    QTimer retryTimer;
    std::unique_ptr<QObject> context; // of what belongs to this connection
    std::optional<QDBusConnection> connection;
    std::unique_ptr<SignalRelay> disconnected;
};

} // namespace pelorus
