// The window's tests, on a screen that nobody sees.

#include "tests/app/TestStyle.h"

#include <QApplication>
#include <QTemporaryDir>
#include <cstdlib>
#include <gmock/gmock.h>

int main(int argc, char** argv)
{
    const QTemporaryDir settings;
    qputenv("QT_QPA_PLATFORM", "offscreen");
    qputenv("XDG_CONFIG_HOME", settings.path().toUtf8());
    qputenv("TZ", "UTC-2"); // local time is two hours ahead
    qunsetenv("DBUS_SESSION_BUS_ADDRESS");
    qputenv("XDG_RUNTIME_DIR", settings.path().toUtf8());
    testing::InitGoogleMock(&argc, argv);
    QCoreApplication::setOrganizationName("io.pelorus");
    QCoreApplication::setApplicationName("Pelorus");
    const QApplication application(argc, argv);
    QApplication::setStyle(new pelorus::test::TestStyle);
    return RUN_ALL_TESTS();
}
