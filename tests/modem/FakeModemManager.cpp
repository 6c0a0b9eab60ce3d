#include "tests/modem/FakeModemManager.h"

#include <QDBusArgument>
#include <QDBusMetaType>
#include <atomic>
#include <gtest/gtest.h>

namespace pelorus::test {

namespace {

const QString kService = "org.freedesktop.ModemManager1";
const QString kRoot = "/org/freedesktop/ModemManager1";
const QString kProperties = "org.freedesktop.DBus.Properties";
const QString kObjectManager = "org.freedesktop.DBus.ObjectManager";

QString newName()
{
    static std::atomic<int> count = 0;
    return QString("fake-%1").arg(++count);
}

} // namespace

QDBusArgument& operator<<(QDBusArgument& argument, const UnsignedPair& pair)
{
    argument.beginStructure();
    argument << pair.first << pair.second;
    argument.endStructure();
    return argument;
}

const QDBusArgument& operator>>(const QDBusArgument& argument, UnsignedPair&)
{
    return argument;
}

FakeModemManager::FakeModemManager(const QString& address)
    : bus(QDBusConnection::connectToBus(address, newName())), name(bus.name())
{
    qDBusRegisterMetaType<UnsignedPair>();
    qDBusRegisterMetaType<FakeInterfaces>();
    qDBusRegisterMetaType<FakeObjects>();
    qDBusRegisterMetaType<FakeCells>();
    qDBusRegisterMetaType<FakeLocation>();
    EXPECT_TRUE(bus.isConnected());
    EXPECT_TRUE(bus.registerVirtualObject(kRoot, this, QDBusConnection::SubPath));
}

FakeModemManager::~FakeModemManager()
{
    bus.unregisterObject(kRoot);
    QDBusConnection::disconnectFromBus(name);
}

void FakeModemManager::appear()
{
    EXPECT_TRUE(bus.registerService(kService));
}

void FakeModemManager::vanish()
{
    EXPECT_TRUE(bus.unregisterService(kService));
    objects.clear();
}

void FakeModemManager::add(const QString& path, const FakeInterfaces& interfaces)
{
    objects[path].insert(interfaces);
    if (!path.contains("/Modem/"))
        return;
    QDBusMessage signal = QDBusMessage::createSignal(kRoot, kObjectManager, "InterfacesAdded");
    signal << QVariant::fromValue(QDBusObjectPath(path)) << QVariant::fromValue(interfaces);
    bus.send(signal);
}

void FakeModemManager::remove(const QString& path, const QStringList& interfaces)
{
    for (const QString& interface : interfaces)
        objects[path].remove(interface);
    if (objects[path].isEmpty())
        objects.remove(path);
    QDBusMessage signal = QDBusMessage::createSignal(kRoot, kObjectManager, "InterfacesRemoved");
    signal << QVariant::fromValue(QDBusObjectPath(path)) << interfaces;
    bus.send(signal);
}

void FakeModemManager::change(const QString& path, const QString& interface, const QVariantMap& properties)
{
    objects[path][interface].insert(properties);
    QDBusMessage signal = QDBusMessage::createSignal(path, kProperties, "PropertiesChanged");
    signal << interface << properties << QStringList();
    bus.send(signal);
}

int FakeModemManager::count(const QString& call) const
{
    return static_cast<int>(std::count(calls.begin(), calls.end(), call));
}

QVariantList FakeModemManager::answer(const QDBusMessage& message)
{
    const QVariantList arguments = message.arguments();
    const QString last = message.interface().section('.', -1);
    if (message.member() == "GetManagedObjects") {
        FakeObjects managed;
        for (auto object = objects.begin(); object != objects.end(); ++object)
            if (object.key().contains("/Modem/"))
                managed.insert(QDBusObjectPath(object.key()), object.value());
        return {QVariant::fromValue(managed)};
    }
    if (message.member() == "GetAll")
        return {objects.value(message.path()).value(arguments.value(0).toString())};
    if (last == "Signal" && message.member() == "Setup")
        change(message.path(), message.interface(), {{"Rate", arguments.value(0).toUInt()}});
    else if (last == "Location" && message.member() == "Setup")
        change(message.path(), message.interface(), {{"Enabled", arguments.value(0).toUInt()}});
    else if (message.member() == "GetLocation")
        return {QVariant::fromValue(FakeLocation())};
    return {};
}

bool FakeModemManager::handleMessage(const QDBusMessage& message, const QDBusConnection&)
{
    QStringList shown;
    for (const QVariant& argument : message.arguments())
        shown.append(argument.toString());
    calls.push_back(
        QString("%1.%2(%3)").arg(message.interface().section('.', -1), message.member(), shown.join(", ")));
    message.setDelayedReply(true);
    const FakeAnswer* planned = answers.contains(message.member()) ? &answers[message.member()] : nullptr;
    if (planned && planned->silent)
        return true;
    if (planned && !planned->error.isEmpty())
        bus.send(message.createErrorReply(planned->error, "as planned"));
    else
        bus.send(message.createReply(planned && !planned->arguments.isEmpty() ? planned->arguments
                                                                              : answer(message)));
    return true;
}

} // namespace pelorus::test
