#pragma once

#include "telephonyd/modem/ObjectTree.h"

#include <string>

namespace pelorus {

/// The path of the modem to read; empty when there is none. `wanted` is its device identifier, or empty for
/// the first that is enabled, or where none is the first that has not failed. The `current` one is kept as
/// long as no other is better.
QString chooseModem(const ObjectTree& objects, const QString& wanted, const QString& current);

/// Why there is none: what there is instead.
std::string whyNoModem(const ObjectTree& objects, const QString& wanted);

/// MMModemState of a modem; the value of a property that is missing is unknown, 0.
int stateOf(const QVariantMap& modem);

} // namespace pelorus
