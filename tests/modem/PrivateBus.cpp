#include "tests/modem/PrivateBus.h"

#include <QFile>
#include <gtest/gtest.h>

namespace pelorus::test {

namespace {

constexpr const char* kConfiguration =
    R"(<!DOCTYPE busconfig PUBLIC "-//freedesktop//DTD D-BUS Bus Configuration 1.0//EN"
 "http://www.freedesktop.org/standards/dbus/1.0/busconfig.dtd">
<busconfig>
  <listen>%1</listen>
  <policy context="default"><allow send_destination="*"/><allow receive_type="method_call"/><allow receive_type="method_return"/><allow receive_type="error"/><allow receive_type="signal"/><allow own="*"/></policy>
</busconfig>
)";

} // namespace

PrivateBus::~PrivateBus()
{
    stop();
}

void PrivateBus::start()
{
    const QString configuration = directory.filePath("bus.conf");
    QFile file(configuration);
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write(QString(kConfiguration).arg(address()).toUtf8());
    file.close();
    daemon.setStandardErrorFile(QProcess::nullDevice()); // it may not raise its limits, and says so
    daemon.start("dbus-daemon", {"--nofork", "--config-file=" + configuration, "--print-address=1"});
    ASSERT_TRUE(daemon.waitForReadyRead(20000)) << "dbus-daemon does not start";
    daemon.readAllStandardOutput();
}

void PrivateBus::stop()
{
    if (daemon.state() == QProcess::NotRunning)
        return;
    daemon.kill();
    daemon.waitForFinished();
    QFile::remove(directory.filePath("bus"));
}

} // namespace pelorus::test
