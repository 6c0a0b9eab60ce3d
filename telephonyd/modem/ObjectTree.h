#pragma once

#include <QVariantMap>

namespace pelorus {

/// Properties by interface and path, as a service tells and changes them. Values are plain ones.
class ObjectTree {
public:
    using Interfaces = QMap<QString, QVariantMap>;

    /// What GetManagedObjects() returned, instead of all that was there.
    void replace(const QVariantMap& managedObjects);
    void add(const QString& path, const QVariantMap& interfaces);
    /// An object without interfaces is gone.
    void remove(const QString& path, const QVariantList& interfaces);
    /// Nothing for an interface that is not there: its properties are told when it comes.
    void change(const QString& path, const QString& interface, const QVariantMap& changed);
    void clear() { objects.clear(); }

    QStringList paths() const { return objects.keys(); }
    bool has(const QString& path, const QString& interface) const;
    /// Empty when it is not there.
    QVariantMap properties(const QString& path, const QString& interface) const;

private:
    QMap<QString, Interfaces> objects;
};

} // namespace pelorus
