#include "app/HomeScreenPreferences.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QFile>
#include <QSettings>

namespace pelorus {

namespace {

const QString kDomain = QStringLiteral("io.pelorus.HomeScreen");

/// Asking for a bus where there is none could start one.
bool isThereASessionBus()
{
    return qEnvironmentVariableIsSet("DBUS_SESSION_BUS_ADDRESS") ||
           (qEnvironmentVariableIsSet("XDG_RUNTIME_DIR") &&
            QFile::exists(qEnvironmentVariable("XDG_RUNTIME_DIR") + QStringLiteral("/bus")));
}

void notifyOf(const char* key)
{
    if (!isThereASessionBus())
        return;
    const QDBusConnection bus = QDBusConnection::sessionBus();
    if (!bus.isConnected())
        return;
    auto message = QDBusMessage::createSignal(QStringLiteral("/io/pelorus/HomeScreen"), kDomain,
                                              QStringLiteral("PreferencesChanged"));
    message << kDomain << QString::fromLatin1(key);
    bus.send(message);
}

} // namespace

void LinuxHomeScreenPreferences::setBoolean(const char* key, bool truth)
{
    QSettings domain(QStringLiteral("io.pelorus"), QStringLiteral("HomeScreen"));
    domain.setValue(QString::fromLatin1(key), truth);
    domain.sync();
    notifyOf(key);
}

} // namespace pelorus
