#pragma once

#include "platform/Value.h"

#include <QVariantMap>

namespace pelorus {

/// The SIM's files, as far as ModemManager tells them: of the Sim object and of the Modem interface. Each is
/// there, empty when it is not known: a display that showed another SIM must not go on showing its files.
Value simFilesOf(const QVariantMap& sim, const QVariantMap& modem);

} // namespace pelorus
