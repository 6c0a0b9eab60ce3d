#pragma once

#include "platform/Value.h"

#include <QVariantMap>

namespace pelorus {

/// The rows of one packet data context: of the Bearer object at that path. Never a user name or a password.
Value bearerRows(const QString& path, const QVariantMap& bearer);

} // namespace pelorus
