#include "telephonyd/modem/PlainValue.h"

#include <QDBusArgument>
#include <QDBusObjectPath>
#include <QDBusSignature>
#include <QDBusVariant>
#include <cmath>

namespace pelorus {

namespace {

QVariantList plainList(const QDBusArgument& argument)
{
    QVariantList list;
    while (!argument.atEnd())
        list.append(plainValue(argument.asVariant()));
    return list;
}

QVariant plainArgument(const QDBusArgument& argument)
{
    switch (argument.currentType()) {
    case QDBusArgument::ArrayType: {
        argument.beginArray();
        const QVariantList list = plainList(argument);
        argument.endArray();
        return list;
    }
    case QDBusArgument::StructureType: {
        argument.beginStructure();
        const QVariantList list = plainList(argument);
        argument.endStructure();
        return list;
    }
    case QDBusArgument::MapType: {
        QVariantMap map;
        argument.beginMap();
        while (!argument.atEnd()) {
            argument.beginMapEntry();
            const QString key = plainValue(argument.asVariant()).toString();
            map.insert(key, plainValue(argument.asVariant()));
            argument.endMapEntry();
        }
        argument.endMap();
        return map;
    }
    case QDBusArgument::BasicType:
    case QDBusArgument::VariantType:
        return plainValue(argument.asVariant());
    case QDBusArgument::MapEntryType:
    case QDBusArgument::UnknownType:
        break;
    }
    return {};
}

bool isNumber(const QVariant& value)
{
    switch (value.typeId()) {
    case QMetaType::Int:
    case QMetaType::UInt:
    case QMetaType::Short:
    case QMetaType::UShort:
    case QMetaType::UChar:
    case QMetaType::LongLong:
    case QMetaType::ULongLong:
    case QMetaType::Double:
        return true;
    default:
        return false;
    }
}

} // namespace

QVariant plainValue(const QVariant& argument)
{
    if (argument.metaType() == QMetaType::fromType<QDBusArgument>())
        return plainArgument(argument.value<QDBusArgument>());
    if (argument.metaType() == QMetaType::fromType<QDBusVariant>())
        return plainValue(argument.value<QDBusVariant>().variant());
    if (argument.metaType() == QMetaType::fromType<QDBusObjectPath>())
        return argument.value<QDBusObjectPath>().path();
    if (argument.metaType() == QMetaType::fromType<QDBusSignature>())
        return argument.value<QDBusSignature>().signature();
    if (argument.typeId() == QMetaType::QStringList)
        return QVariantList(argument.toList());
    return argument;
}

std::optional<std::uint64_t> longAt(const QVariantMap& map, const char* key)
{
    const QVariant value = map.value(QLatin1String(key));
    if (!isNumber(value) || value.typeId() == QMetaType::Double)
        return std::nullopt;
    if (value.typeId() != QMetaType::ULongLong && value.toLongLong() < 0)
        return std::nullopt;
    return value.toULongLong();
}

std::optional<std::uint32_t> unsignedAt(const QVariantMap& map, const char* key)
{
    const auto number = longAt(map, key);
    if (!number || *number > 0xFFFFFFFF)
        return std::nullopt;
    return static_cast<std::uint32_t>(*number);
}

std::optional<double> realAt(const QVariantMap& map, const char* key)
{
    const QVariant value = map.value(QLatin1String(key));
    if (!isNumber(value) || !std::isfinite(value.toDouble()))
        return std::nullopt;
    return value.toDouble();
}

std::string textAt(const QVariantMap& map, const char* key)
{
    const QVariant value = map.value(QLatin1String(key));
    return value.typeId() == QMetaType::QString ? value.toString().toStdString() : std::string();
}

bool flagAt(const QVariantMap& map, const char* key)
{
    const QVariant value = map.value(QLatin1String(key));
    return value.typeId() == QMetaType::Bool && value.toBool();
}

QVariantMap mapAt(const QVariantMap& map, const char* key)
{
    const QVariant value = map.value(QLatin1String(key));
    return value.typeId() == QMetaType::QVariantMap ? value.toMap() : QVariantMap();
}

QVariantList listAt(const QVariantMap& map, const char* key)
{
    const QVariant value = map.value(QLatin1String(key));
    return value.typeId() == QMetaType::QVariantList ? value.toList() : QVariantList();
}

} // namespace pelorus
