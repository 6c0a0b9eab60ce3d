#pragma once

#include "platform/linux/CallbackBoundary.h"

#include <QApplication>

namespace pelorus {

/// The toolkit's application, behind the boundary that no exception passes: one that leaves an event handler
/// ends the program there and then.
class Application : public QApplication {
public:
    using QApplication::QApplication;
    bool notify(QObject* receiver, QEvent* event) override
    {
        return callAtBoundary([&] { return QApplication::notify(receiver, event); });
    }
};

} // namespace pelorus
