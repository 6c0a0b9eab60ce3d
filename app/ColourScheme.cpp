#include "app/ColourScheme.h"

#include "app/SessionBus.h"

#include <QApplication>
#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QDBusVariant>
#include <QPalette>

namespace pelorus {

namespace {

const QString kService = QStringLiteral("org.freedesktop.portal.Desktop");
const QString kPath = QStringLiteral("/org/freedesktop/portal/desktop");
const QString kInterface = QStringLiteral("org.freedesktop.portal.Settings");
const QString kGroup = QStringLiteral("org.freedesktop.appearance");
const QString kKey = QStringLiteral("color-scheme");
constexpr uint kPreferDark = 1; // of 0 no preference, 1 dark, 2 light

/// What is inside a variant, however often it was wrapped.
QVariant unwrapped(QVariant value)
{
    while (value.canConvert<QDBusVariant>())
        value = value.value<QDBusVariant>().variant();
    return value;
}

QPalette darkPalette()
{
    QPalette dark(QColor(0x33, 0x35, 0x39), QColor(0x24, 0x26, 0x29)); // button and window, the rest of them
    dark.setColor(QPalette::Base, QColor(0x1b, 0x1c, 0x1f));
    dark.setColor(QPalette::AlternateBase, QColor(0x21, 0x23, 0x26));
    for (const auto role :
         {QPalette::Text, QPalette::WindowText, QPalette::ButtonText, QPalette::ToolTipText})
        dark.setColor(role, QColor(0xe8, 0xe8, 0xea));
    dark.setColor(QPalette::PlaceholderText, QColor(0x8c, 0x8e, 0x94));
    dark.setColor(QPalette::ToolTipBase, QColor(0x33, 0x35, 0x39));
    dark.setColor(QPalette::Highlight, QColor(0x2f, 0x7f, 0xb8));
    dark.setColor(QPalette::HighlightedText, Qt::white);
    dark.setColor(QPalette::Link, QColor(0x6c, 0xb4, 0xe6));
    for (const auto role : {QPalette::Text, QPalette::WindowText, QPalette::ButtonText})
        dark.setColor(QPalette::Disabled, role, QColor(0x77, 0x79, 0x7e));
    return dark;
}

} // namespace

ColourScheme::ColourScheme()
{
    if (!isThereASessionBus())
        return;
    QDBusConnection bus = QDBusConnection::sessionBus();
    bus.connect(kService, kPath, kInterface, QStringLiteral("SettingChanged"), this,
                SLOT(settingChanged(QDBusMessage)));
    auto message = QDBusMessage::createMethodCall(kService, kPath, kInterface, QStringLiteral("Read"));
    message << kGroup << kKey;
    auto* watcher = new QDBusPendingCallWatcher(bus.asyncCall(message), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this, [](QDBusPendingCallWatcher* answered) {
        const QDBusPendingReply<QDBusVariant> reply = *answered;
        if (reply.isValid())
            apply(unwrapped(reply.value().variant()).toUInt() == kPreferDark);
        answered->deleteLater();
    });
}

void ColourScheme::settingChanged(const QDBusMessage& message)
{
    const QVariantList arguments = message.arguments();
    if (arguments.size() == 3 && arguments[0] == kGroup && arguments[1] == kKey)
        apply(unwrapped(arguments[2]).toUInt() == kPreferDark);
}

void ColourScheme::apply(bool dark)
{
    QApplication::setPalette(QPalette()); // the toolkit's own
    if (dark && QApplication::palette().color(QPalette::Window).lightness() > 127)
        QApplication::setPalette(darkPalette());
}

} // namespace pelorus
