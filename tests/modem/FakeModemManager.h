#pragma once

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusObjectPath>
#include <QDBusVariant>
#include <QDBusVirtualObject>
#include <map>
#include <optional>
#include <vector>

namespace pelorus::test {

using FakeInterfaces = QMap<QString, QVariantMap>;

/// CurrentModes and others: (uu).
struct UnsignedPair {
    unsigned first = 0;
    unsigned second = 0;
};

/// What a modem does when a method is called.
struct FakeAnswer {
    QVariantList arguments = {};
    QString error = {}; // instead of the arguments
    bool silent = false;
};

/// A service with ModemManager's names and habits: only modems are among the managed objects.
class FakeModemManager : public QDBusVirtualObject {
public:
    explicit FakeModemManager(const QString& address);
    ~FakeModemManager() override;

    void appear(); // on the bus
    void vanish(); // with all of its state
    void add(const QString& path, const FakeInterfaces& interfaces);
    void remove(const QString& path, const QStringList& interfaces);
    void change(const QString& path, const QString& interface, const QVariantMap& properties);

    QString introspect(const QString&) const override { return {}; }
    bool handleMessage(const QDBusMessage& message, const QDBusConnection& from) override;

    int count(const QString& call) const;

    QMap<QString, FakeInterfaces> objects;
    QMap<QString, FakeAnswer> answers; // by method; otherwise as the real one
    std::vector<QString> calls;        // "Signal.Setup(2)"
    QDBusConnection bus;

private:
    QVariantList answer(const QDBusMessage& message);
    QString name;
};

/// a{oa{sa{sv}}}, as GetManagedObjects() returns it, and the other types that need a name.
using FakeObjects = QMap<QDBusObjectPath, FakeInterfaces>;
using FakeCells = QList<QVariantMap>;
using FakeLocation = QMap<unsigned, QDBusVariant>;

} // namespace pelorus::test

Q_DECLARE_METATYPE(pelorus::test::UnsignedPair)
