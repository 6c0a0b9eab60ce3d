#include "telephonyd/modem/ModemManagerClient.h"

#include "telephonyd/modem/ModemNames.h"
#include "telephonyd/modem/PlainValue.h"

namespace pelorus {

namespace {

using namespace ModemNames;

const QString kBusService = QStringLiteral("org.freedesktop.DBus");
const QString kBusPath = QStringLiteral("/org/freedesktop/DBus");

bool isError(const QDBusMessage& reply)
{
    return reply.type() == QDBusMessage::ErrorMessage;
}

QVariant argument(const QDBusMessage& message, qsizetype index)
{
    return plainValue(message.arguments().value(index));
}

} // namespace

ModemManagerClient::ModemManagerClient(Settings settings, Complaints& complaints)
    : settings(std::move(settings)), complaints(complaints),
      bus(this->settings.busAddress, this->settings.retry)
{
    retryTimer.setSingleShot(true);
    retryTimer.setInterval(this->settings.retry);
    QObject::connect(&retryTimer, &QTimer::timeout, &retryTimer, [this] {
        if (owner.isEmpty())
            getObjects();
        for (auto object = followed.begin(); object != followed.end(); ++object)
            if (!tree.has(object.key(), object.value()))
                getProperties(object.key(), object.value());
    });
}

void ModemManagerClient::start(std::function<void()> callback)
{
    changed = std::move(callback);
    bus.open({.connected =
                  [this] {
                      complaints.isOver("bus");
                      subscribeToService();
                      getObjects();
                  },
              .lost =
                  [this](const std::string& why) {
                      watches.clear();
                      const std::string line = "the system bus cannot be reached: " + why;
                      complaints.say("bus", "modem: " + line + "; trying again");
                      forgetService(line);
                  }});
}

std::function<void(const QDBusMessage&)>
ModemManagerClient::fromService(void (ModemManagerClient::*handler)(const QDBusMessage&))
{
    return [this, handler](const QDBusMessage& signal) {
        if (!owner.isEmpty() && signal.service() == owner) // anybody may send signals of any name
            (this->*handler)(signal);
    };
}

/// Before anything is asked for, so that no change is missed. Of changes of properties only those of the
/// interfaces that count: the system bus is full of others'.
void ModemManagerClient::subscribeToService()
{
    watches.clear();
    watches.push_back(
        bus.subscribe({.service = kBusService,
                       .path = kBusPath,
                       .interface = kBusService,
                       .signal = QStringLiteral("NameOwnerChanged"),
                       .firstArguments = {kService}},
                      [this](const QDBusMessage& signal) { handleOwner(argument(signal, 2).toString()); }));
    watches.push_back(bus.subscribe(
        {.path = kRoot, .interface = kObjectManager, .signal = QStringLiteral("InterfacesAdded")},
        fromService(&ModemManagerClient::handleInterfacesAdded)));
    watches.push_back(bus.subscribe(
        {.path = kRoot, .interface = kObjectManager, .signal = QStringLiteral("InterfacesRemoved")},
        fromService(&ModemManagerClient::handleInterfacesRemoved)));
    for (const QString& interface : {kModem, kModem3gpp, kSignal, kLocation, kSim, kBearer})
        watches.push_back(bus.subscribe({.interface = kProperties,
                                         .signal = QStringLiteral("PropertiesChanged"),
                                         .firstArguments = {interface}},
                                        fromService(&ModemManagerClient::handlePropertiesChanged)));
}

void ModemManagerClient::handleOwner(const QString& newOwner)
{
    if (newOwner == owner)
        return;
    if (!owner.isEmpty()) {
        const std::string line = "ModemManager has ended; waiting for it";
        complaints.say("service", "modem: " + line);
        forgetService(line);
    }
    if (!newOwner.isEmpty())
        getObjects();
}

void ModemManagerClient::forgetService(const std::string& why)
{
    owner.clear();
    tree.clear();
    followed.clear();
    trouble = why;
    changed();
}

void ModemManagerClient::getObjects()
{
    retryTimer.stop();
    bus.call({kService, kRoot, kObjectManager, QStringLiteral("GetManagedObjects")}, settings.callTimeout,
             [this](const QDBusMessage& reply) { takeObjects(reply); });
}

void ModemManagerClient::takeObjects(const QDBusMessage& reply)
{
    if (isError(reply)) {
        const std::string line =
            explainError(QStringLiteral("GetManagedObjects"), reply.errorName(), reply.errorMessage());
        complaints.say("service", line);
        trouble = line;
        if (!isServiceMissing(reply.errorName())) // its coming is signalled
            retryTimer.start();
        changed();
        return;
    }
    complaints.isOver("service");
    owner = reply.service();
    trouble.clear();
    tree.replace(argument(reply, 0).toMap());
    followed.clear();
    changed();
}

void ModemManagerClient::handleInterfacesAdded(const QDBusMessage& signal)
{
    tree.add(argument(signal, 0).toString(), argument(signal, 1).toMap());
    changed();
}

void ModemManagerClient::handleInterfacesRemoved(const QDBusMessage& signal)
{
    tree.remove(argument(signal, 0).toString(), argument(signal, 1).toList());
    changed();
}

void ModemManagerClient::follow(const QMap<QString, QString>& interfacesByPath)
{
    if (interfacesByPath == followed)
        return;
    const QMap<QString, QString> before = std::exchange(followed, interfacesByPath);
    for (auto object = before.begin(); object != before.end(); ++object)
        if (!followed.contains(object.key()))
            tree.remove(object.key(), {object.value()});
    for (auto object = followed.begin(); object != followed.end(); ++object)
        if (!before.contains(object.key()))
            getProperties(object.key(), object.value());
}

void ModemManagerClient::getProperties(const QString& path, const QString& interface)
{
    call(path, kProperties, QStringLiteral("GetAll"), {interface},
         [this, path, interface](const QDBusMessage& reply) {
             if (isError(reply)) {
                 if (!isObjectMissing(reply.errorName())) // it went while it was asked for
                     complaints.say(path.toStdString(),
                                    explainError(QStringLiteral("Properties.GetAll"), reply.errorName(),
                                                 reply.errorMessage()));
                 retryTimer.start();
                 return;
             }
             complaints.isOver(path.toStdString());
             if (followed.value(path) != interface && !tree.has(path, interface))
                 return; // gone meanwhile
             tree.add(path, {{interface, argument(reply, 0)}});
             changed();
         });
}

void ModemManagerClient::handlePropertiesChanged(const QDBusMessage& signal)
{
    const QString interface = argument(signal, 0).toString();
    tree.change(signal.path(), interface, argument(signal, 1).toMap());
    if (!argument(signal, 2).toList().isEmpty() && tree.has(signal.path(), interface))
        getProperties(signal.path(), interface);
    changed();
}

void ModemManagerClient::call(const QString& path, const QString& interface, const QString& method,
                              const QVariantList& arguments, SystemBus::Reply reply)
{
    if (owner.isEmpty())
        return;
    bus.call({owner, path, interface, method, arguments}, settings.callTimeout,
             [this, calledOwner = owner, reply = std::move(reply)](const QDBusMessage& message) {
                 if (calledOwner == owner)
                     reply(message);
             });
}

} // namespace pelorus
