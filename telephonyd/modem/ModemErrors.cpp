#include "telephonyd/modem/ModemErrors.h"

#include <fmt/format.h>

namespace pelorus {

namespace {

const QString kModemErrors = QStringLiteral("org.freedesktop.ModemManager1.Error.Core.");
const QString kBusErrors = QStringLiteral("org.freedesktop.DBus.Error.");

std::string lost(const QString& what)
{
    if (what == QLatin1String("GetCellInfo"))
        return "neighbour cells and the serving cell's channel are not shown";
    if (what == QLatin1String("GetLocation") || what == QLatin1String("Location.Setup"))
        return "the serving cell's area and identity are not shown";
    if (what == QLatin1String("Signal.Setup"))
        return "the serving cell's levels are not shown";
    if (what == QLatin1String("Properties.GetAll"))
        return "the SIM's files or a data context are not shown";
    return "there is no modem without it";
}

const char* cure(const QString& what, const QString& error)
{
    if (error == kBusErrors + QLatin1String("AccessDenied"))
        return what == QLatin1String("GetCellInfo")
                   ? "the bus policy of ModemManager does not allow it; io.pelorus.telephonyd.conf does "
                     "(install with -DPELORUS_INSTALL_BUS_POLICY=ON, then: systemctl reload dbus)"
                   : "the bus policy does not allow it to this user";
    if (error == kModemErrors + QLatin1String("Unauthorized"))
        return "polkit does not allow it from here; run in the desktop session, or give the user a "
               "polkit rule as pelorus-telephonyd(1) shows";
    if (error == kModemErrors + QLatin1String("WrongState"))
        return "the modem is not enabled (mmcli -m any -e) or not on a network";
    if (isUnsupported(error))
        return "this modem cannot do it, or ModemManager not with it";
    if (error == kBusErrors + QLatin1String("NoReply") || error == kBusErrors + QLatin1String("Timeout") ||
        error == kBusErrors + QLatin1String("TimedOut"))
        return "no answer";
    return nullptr;
}

} // namespace

bool isUnsupported(const QString& errorName)
{
    return errorName == kModemErrors + QLatin1String("Unsupported") ||
           errorName == kBusErrors + QLatin1String("UnknownMethod");
}

bool isObjectMissing(const QString& errorName)
{
    return errorName == kBusErrors + QLatin1String("UnknownObject") ||
           errorName == kBusErrors + QLatin1String("UnknownMethod");
}

bool isServiceMissing(const QString& errorName)
{
    return errorName == kBusErrors + QLatin1String("ServiceUnknown") ||
           errorName == kBusErrors + QLatin1String("NameHasNoOwner") ||
           errorName.startsWith(kBusErrors + QLatin1String("Spawn."));
}

std::string explainError(const QString& what, const QString& errorName, const QString& errorMessage)
{
    if (isServiceMissing(errorName))
        return fmt::format(
            "modem: ModemManager does not run and is not started by the bus; install it (package "
            "modemmanager) or start it (systemctl start ModemManager): {}",
            errorMessage.toStdString());
    const char* reason = cure(what, errorName);
    const std::string said = fmt::format("{}: {}", errorName.toStdString(), errorMessage.toStdString());
    return fmt::format("modem: {} failed, {}: {}", what.toStdString(), lost(what),
                       reason ? fmt::format("{} ({})", reason, said) : said);
}

void Complaints::say(const std::string& topic, const std::string& line)
{
    const auto [entry, isNew] = said.try_emplace(topic, line);
    if (!isNew && entry->second == line)
        return;
    entry->second = line;
    report(line);
}

} // namespace pelorus
