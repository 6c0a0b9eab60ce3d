#pragma once

#include <QObject>

class QDBusMessage;

namespace pelorus {

/// Follows the desktop's wish for dark colours where the toolkit does not: asks the settings portal on the
/// session bus, without waiting, and listens to it. Without a bus or a portal the colours are the toolkit's.
class ColourScheme : public QObject {
    Q_OBJECT
public:
    ColourScheme();

    /// The toolkit's colours, or dark ones when it is to be dark and the toolkit's are not.
    static void apply(bool dark);

private Q_SLOTS:
    void settingChanged(const QDBusMessage& message);
};

} // namespace pelorus
