#include "app/HomeScreenPreferences.h"

#include "app/SessionBus.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QSettings>

namespace pelorus {

namespace {

const QString kDomain = QStringLiteral("io.pelorus.HomeScreen");

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
