#include "app/StartAlert.h"

#include "platform/linux/SignalWatch.h"

#include <QGuiApplication>
#include <QMessageBox>
#include <csignal>

namespace pelorus {

namespace {

bool isSeen()
{
    const QString platform = QGuiApplication::platformName();
    return platform != QLatin1String("offscreen") && platform != QLatin1String("minimal");
}

} // namespace

void showStartAlert(const std::string& reason)
{
    if (!isSeen())
        return;
    QMessageBox alert(QMessageBox::Critical, QStringLiteral("Pelorus"), QObject::tr("Pelorus cannot start."),
                      QMessageBox::NoButton);
    alert.setTextFormat(Qt::PlainText);
    alert.setInformativeText(QString::fromStdString(reason));
    alert.addButton(QStringLiteral("Close"), QMessageBox::RejectRole);
    const SignalWatch signals({SIGINT, SIGTERM, SIGHUP}, [&alert](int) { alert.reject(); });
    alert.exec();
}

} // namespace pelorus
