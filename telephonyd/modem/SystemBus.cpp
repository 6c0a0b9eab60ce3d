#include "telephonyd/modem/SystemBus.h"

#include <QDBusError>
#include <QDBusPendingCallWatcher>
#include <QThread>
#include <atomic>

namespace pelorus {

namespace {

QString newConnectionName()
{
    static std::atomic<unsigned> count = 0;
    return QStringLiteral("pelorus-telephonyd-%1").arg(++count);
}

} // namespace

SystemBus::SystemBus(QString address, std::chrono::milliseconds retry) : address(std::move(address))
{
    retryTimer.setSingleShot(true);
    retryTimer.setInterval(retry);
    QObject::connect(&retryTimer, &QTimer::timeout, &retryTimer, [this] { connect(); });
}

SystemBus::~SystemBus()
{
    context.reset();
    disconnected.reset();
    if (connection)
        QDBusConnection::disconnectFromBus(name);
}

void SystemBus::open(Callbacks whatToCall)
{
    callbacks = std::move(whatToCall);
    connect();
}

void SystemBus::connect()
{
    name = newConnectionName();
    context = std::make_unique<QObject>();
    QThread* connecting = QThread::create([busAddress = address, newName = name] {
        if (busAddress.isEmpty())
            QDBusConnection::connectToBus(QDBusConnection::SystemBus, newName);
        else
            QDBusConnection::connectToBus(busAddress, newName);
    });
    QObject::connect(connecting, &QThread::finished, context.get(), [this] { takeConnection(); });
    QObject::connect(connecting, &QThread::finished, connecting, &QObject::deleteLater);
    connecting->start();
}

void SystemBus::takeConnection()
{
    QDBusConnection made(name);
    if (!made.isConnected()) {
        const std::string why = made.lastError().message().toStdString();
        QDBusConnection::disconnectFromBus(name);
        lose(why.empty() ? "nobody answers" : why);
        return;
    }
    connection = made;
    disconnected = subscribe({.path = QStringLiteral("/org/freedesktop/DBus/Local"),
                              .interface = QStringLiteral("org.freedesktop.DBus.Local"),
                              .signal = QStringLiteral("Disconnected")},
                             [this](const QDBusMessage&) {
                                 // Not inside the call of what it takes away.
                                 QTimer::singleShot(0, context.get(), [this] { lose("it went away"); });
                             });
    callbacks.connected();
}

void SystemBus::lose(const std::string& why)
{
    disconnected.reset();
    if (connection)
        QDBusConnection::disconnectFromBus(name);
    connection.reset();
    if (context)
        context.release()->deleteLater();
    retryTimer.start();
    callbacks.lost(why);
}

void SystemBus::call(const MethodCall& call, std::chrono::milliseconds timeout, Reply reply)
{
    if (!connection)
        return;
    QDBusMessage message =
        QDBusMessage::createMethodCall(call.service, call.path, call.interface, call.method);
    message.setArguments(call.arguments);
    auto* watcher = new QDBusPendingCallWatcher(
        connection->asyncCall(message, static_cast<int>(timeout.count())), context.get());
    QObject::connect(watcher, &QDBusPendingCallWatcher::finished, watcher,
                     [reply = std::move(reply)](QDBusPendingCallWatcher* finished) {
                         finished->deleteLater();
                         reply(finished->reply());
                     });
}

std::unique_ptr<SignalRelay> SystemBus::subscribe(const Subscription& wanted, SignalRelay::Callback callback)
{
    auto relay = std::make_unique<SignalRelay>(std::move(callback));
    if (connection)
        connection->connect(wanted.service, wanted.path, wanted.interface, wanted.signal,
                            wanted.firstArguments, {}, relay.get(), SLOT(relay(QDBusMessage)));
    return relay;
}

} // namespace pelorus
