#pragma once

#include <QStringList>
#include <QVariantMap>
#include <optional>

namespace pelorus {

/// An argument of a D-Bus message without the types of D-Bus: any dictionary is a QVariantMap (keys that are
/// numbers or paths become their text), any other container a QVariantList, object paths are strings. Nothing
/// of what a service may send is refused here.
QVariant plainValue(const QVariant& argument);

// Of a dictionary that a service sent. A value of another type counts as absent.
std::optional<std::uint32_t> unsignedAt(const QVariantMap& map, const char* key);
std::optional<std::uint64_t> longAt(const QVariantMap& map, const char* key);
std::optional<double> realAt(const QVariantMap& map, const char* key);
std::string textAt(const QVariantMap& map, const char* key); // empty when absent
bool flagAt(const QVariantMap& map, const char* key);        // false when absent
QVariantMap mapAt(const QVariantMap& map, const char* key);
QVariantList listAt(const QVariantMap& map, const char* key);

} // namespace pelorus
