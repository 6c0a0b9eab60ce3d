#pragma once

#include <QDBusMessage>
#include <QObject>
#include <functional>

namespace pelorus {

/// The receiver of one D-Bus signal, for as long as it lives.
class SignalRelay : public QObject {
    Q_OBJECT
public:
    using Callback = std::function<void(const QDBusMessage& signal)>;

    explicit SignalRelay(Callback callback);

public Q_SLOTS:
    void relay(const QDBusMessage& signal);

private:
    Callback callback;
};

} // namespace pelorus
