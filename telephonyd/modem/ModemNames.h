#pragma once

#include <QString>

namespace pelorus {

/// ModemManager's names on the bus.
namespace ModemNames {

inline const QString kService = QStringLiteral("org.freedesktop.ModemManager1");
inline const QString kRoot = QStringLiteral("/org/freedesktop/ModemManager1");
inline const QString kModem = QStringLiteral("org.freedesktop.ModemManager1.Modem");
inline const QString kModem3gpp = QStringLiteral("org.freedesktop.ModemManager1.Modem.Modem3gpp");
inline const QString kSignal = QStringLiteral("org.freedesktop.ModemManager1.Modem.Signal");
inline const QString kLocation = QStringLiteral("org.freedesktop.ModemManager1.Modem.Location");
inline const QString kSim = QStringLiteral("org.freedesktop.ModemManager1.Sim");
inline const QString kBearer = QStringLiteral("org.freedesktop.ModemManager1.Bearer");
inline const QString kProperties = QStringLiteral("org.freedesktop.DBus.Properties");
inline const QString kObjectManager = QStringLiteral("org.freedesktop.DBus.ObjectManager");

} // namespace ModemNames

// MMModemState.
constexpr int kStateFailed = -1;
constexpr int kStateLocked = 2;
constexpr int kStateDisabled = 3;
constexpr int kStateEnabled = 6; // and above

} // namespace pelorus
