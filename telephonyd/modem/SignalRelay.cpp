#include "telephonyd/modem/SignalRelay.h"

namespace pelorus {

SignalRelay::SignalRelay(Callback callback) : callback(std::move(callback)) {}

void SignalRelay::relay(const QDBusMessage& signal)
{
    callback(signal);
}

} // namespace pelorus
