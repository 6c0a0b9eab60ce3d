#include "telephonyd/modem/ModemChoice.h"

#include "telephonyd/modem/ModemNames.h"
#include "telephonyd/modem/PlainValue.h"

#include <algorithm>
#include <fmt/format.h>

namespace pelorus {

namespace {

/// The higher the better; below 0 not to be chosen.
int rank(const QVariantMap& modem)
{
    const int state = stateOf(modem);
    return state == kStateFailed ? -1 : state >= kStateEnabled ? 1 : 0;
}

/// Modems in the order in which they came: the number that ends the path.
QStringList modemPaths(const ObjectTree& objects)
{
    QStringList paths = objects.paths();
    paths.removeIf([&](const QString& path) { return !objects.has(path, ModemNames::kModem); });
    std::ranges::stable_sort(paths, {},
                             [](const QString& path) { return path.section('/', -1).toULongLong(); });
    return paths;
}

std::string failureText(const QVariantMap& modem)
{
    switch (unsignedAt(modem, "StateFailedReason").value_or(0)) {
    case 2:
        return "its SIM is missing";
    case 3:
        return "its SIM cannot be read";
    case 4:
        return "what it is able to is not known";
    case 5:
        return "its eSIM has no profile";
    default:
        return "for an unknown reason (journalctl -u ModemManager may tell)";
    }
}

} // namespace

int stateOf(const QVariantMap& modem)
{
    const QVariant state = modem.value(QStringLiteral("State"));
    return state.typeId() == QMetaType::Int ? state.toInt() : 0;
}

QString chooseModem(const ObjectTree& objects, const QString& wanted, const QString& current)
{
    QString best;
    int bestRank = -1;
    for (const QString& path : modemPaths(objects)) {
        const QVariantMap modem = objects.properties(path, ModemNames::kModem);
        if (!wanted.isEmpty() && modem.value(QStringLiteral("DeviceIdentifier")).toString() != wanted)
            continue;
        const int thisRank = rank(modem);
        if (thisRank > bestRank || (thisRank == bestRank && thisRank >= 0 && path == current)) {
            best = path;
            bestRank = thisRank;
        }
    }
    return best;
}

std::string whyNoModem(const ObjectTree& objects, const QString& wanted)
{
    std::string others;
    for (const QString& path : modemPaths(objects)) {
        const QVariantMap modem = objects.properties(path, ModemNames::kModem);
        const std::string identifier = textAt(modem, "DeviceIdentifier");
        if (stateOf(modem) == kStateFailed && (wanted.isEmpty() || identifier == wanted.toStdString()))
            return fmt::format("modem {} failed, {}", identifier, failureText(modem));
        others += (others.empty() ? "" : ", ") + identifier;
    }
    if (wanted.isEmpty() || others.empty())
        return "ModemManager has no modem; waiting for one";
    return fmt::format("ModemManager has no modem {}, only {}; waiting for it", wanted.toStdString(), others);
}

} // namespace pelorus
