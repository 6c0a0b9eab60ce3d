#include "platform/linux/MainQueue.h"

#include "platform/linux/CallbackBoundary.h"

#include <QCoreApplication>

namespace pelorus {

void postToMainQueue(std::function<void()> closure)
{
    QMetaObject::invokeMethod(
        QCoreApplication::instance(), [closure = std::move(closure)] { callAtBoundary(closure); },
        Qt::QueuedConnection);
}

} // namespace pelorus
