#pragma once

#include "telephonyd/server/Report.h"

#include <QString>
#include <map>

namespace pelorus {

/// What an error of the bus or of ModemManager means for whoever runs the server, and what can be done: one
/// line. `what` is the call's name.
std::string explainError(const QString& what, const QString& errorName, const QString& errorMessage);

/// The error by which a modem says that it never can.
bool isUnsupported(const QString& errorName);
/// The object is not there, or no longer.
bool isObjectMissing(const QString& errorName);
/// There is no ModemManager, and none can be started.
bool isServiceMissing(const QString& errorName);

/// Says each thing once, until it is over or becomes another one.
class Complaints {
public:
    explicit Complaints(Report report) : report(std::move(report)) {}

    void say(const std::string& topic, const std::string& line);
    void isOver(const std::string& topic) { said.erase(topic); }

private:
    Report report;
    std::map<std::string, std::string> said;
};

} // namespace pelorus
