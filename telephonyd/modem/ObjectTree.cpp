#include "telephonyd/modem/ObjectTree.h"

namespace pelorus {

void ObjectTree::replace(const QVariantMap& managedObjects)
{
    objects.clear();
    for (auto object = managedObjects.begin(); object != managedObjects.end(); ++object)
        add(object.key(), object->toMap());
}

void ObjectTree::add(const QString& path, const QVariantMap& interfaces)
{
    for (auto interface = interfaces.begin(); interface != interfaces.end(); ++interface)
        objects[path].insert(interface.key(), interface->toMap());
}

void ObjectTree::remove(const QString& path, const QVariantList& interfaces)
{
    const auto object = objects.find(path);
    if (object == objects.end())
        return;
    for (const QVariant& interface : interfaces)
        object->remove(interface.toString());
    if (object->isEmpty())
        objects.erase(object);
}

void ObjectTree::change(const QString& path, const QString& interface, const QVariantMap& changed)
{
    if (has(path, interface))
        objects[path][interface].insert(changed);
}

bool ObjectTree::has(const QString& path, const QString& interface) const
{
    return objects.value(path).contains(interface);
}

QVariantMap ObjectTree::properties(const QString& path, const QString& interface) const
{
    return objects.value(path).value(interface);
}

} // namespace pelorus
