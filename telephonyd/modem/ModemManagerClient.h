#pragma once

#include "telephonyd/modem/ModemErrors.h"
#include "telephonyd/modem/ObjectTree.h"
#include "telephonyd/modem/SystemBus.h"

#include <vector>

namespace pelorus {

/// ModemManager's objects, kept up to date by its signals. Nothing is polled, and a ModemManager that was
/// stopped is not started again: it is waited for.
class ModemManagerClient {
public:
    struct Settings {
        QString busAddress; // empty for the system bus
        std::chrono::milliseconds retry = std::chrono::seconds(10);
        std::chrono::milliseconds callTimeout = std::chrono::seconds(20);
    };

    ModemManagerClient(Settings settings, Complaints& complaints);
    /// Begins; `changed` is called whenever the objects did.
    void start(std::function<void()> changed);

    /// Modems, and what follow() asked for.
    const ObjectTree& objects() const { return tree; }
    /// Objects that are not told of unless they are asked for, by path, with the one interface of each that
    /// counts. Those that were followed before and are not among them are forgotten.
    void follow(const QMap<QString, QString>& interfacesByPath);
    /// Calls a method of a modem. The reply does not come when ModemManager went away meanwhile.
    void call(const QString& path, const QString& interface, const QString& method,
              const QVariantList& arguments, SystemBus::Reply reply);
    /// Why there are no objects; empty when they are known.
    const std::string& whyUnknown() const { return trouble; }

private:
    void subscribeToService();
    void handleOwner(const QString& newOwner);
    void getObjects();
    void takeObjects(const QDBusMessage& reply);
    void getProperties(const QString& path, const QString& interface);
    void handlePropertiesChanged(const QDBusMessage& signal);
    void forgetService(const std::string& why);
    std::function<void(const QDBusMessage&)>
    fromService(void (ModemManagerClient::*handler)(const QDBusMessage&));
    void handleInterfacesAdded(const QDBusMessage& signal);
    void handleInterfacesRemoved(const QDBusMessage& signal);

    Settings settings;
    Complaints& complaints;
    std::function<void()> changed;
    ObjectTree tree;
    QString owner; // unique name of the service; empty while it is not known
    std::string trouble = "ModemManager has not answered yet";
    QMap<QString, QString> followed;
    std::vector<std::unique_ptr<SignalRelay>> watches;
    QTimer retryTimer;
    SystemBus bus; // the last, so that its replies end first
};

} // namespace pelorus
