#include "app/Application.h"
#include "app/ColourScheme.h"
#include "app/Display.h"
#include "app/PelorusApp.h"
#include "app/StartAlert.h"
#include "platform/Console.h"
#include "platform/linux/LinuxPlatform.h"
#include "platform/linux/PortDirectory.h"
#include "platform/linux/ResourceDirectory.h"
#include "platform/linux/SignalWatch.h"
#include "platform/linux/SyslogSink.h"
#include "platform/linux/UncaughtException.h"

#include <QShortcut>
#include <clocale>
#include <csignal>
#include <cstdio>

namespace {

using namespace pelorus;

/// The toolkit starts threads of its own; no signal may end the program through one of them.
void blockSignals()
{
    sigset_t set;
    sigemptyset(&set);
    for (const int signal : {SIGINT, SIGTERM, SIGHUP})
        sigaddset(&set, signal);
    pthread_sigmask(SIG_BLOCK, &set, nullptr);
}

int runApplication()
{
    const ColourScheme colours;
    LinuxPlatform platform;
    LinuxHomeScreenPreferences homeScreen;
    PelorusApp app(platform, homeScreen, ResourceDirectory::besideThisProgram().path());
    setLastWords([&app, &platform](const std::string& exception) {
        if (!app.getModel())
            return;
        std::string why;
        if (app.getModel()->writeRecoverySnapshot(exception, &why))
            fmt::print(stderr, "pelorus: ended by {}; what was captured is in {}\n", exception,
                       platform.snapshotDirectory());
        else
            fmt::print(stderr, "pelorus: ended by {}; what was captured cannot be saved: {}\n", exception,
                       why);
    });
    app.applicationDidFinishLaunching();
    QObject::connect(new QShortcut(QKeySequence::Quit, app.getWindow()), &QShortcut::activated, qApp,
                     &QApplication::quit);
    int status = 0;
    {
        const SignalWatch signals({SIGINT, SIGTERM, SIGHUP}, [](int) { QApplication::quit(); });
        status = QApplication::exec();
    }
    app.applicationWillTerminate();
    setLastWords(nullptr);
    return status;
}

} // namespace

int main(int argc, char** argv)
{
    blockSignals();
    reportUncaughtException();
    endWithoutDisplay(argc, argv);
    QCoreApplication::setOrganizationName("io.pelorus");
    QCoreApplication::setApplicationName("Pelorus");
    QCoreApplication::setApplicationVersion(PELORUS_VERSION);
    QGuiApplication::setDesktopFileName("io.pelorus.Pelorus");
    const Application application(argc, argv);
    displayIsThere();
    std::setlocale(LC_NUMERIC, "C"); // which Qt has set to the user's; a level has a point in any language

    std::string why;
    if (!PortDirectory::open(why)) {
        fmt::print(stderr, "pelorus: {}\n", why);
        showStartAlert(why);
        return 1;
    }
    SyslogSink log("pelorus");
    setSystemLogSink(&log);
    setConsole([](std::string_view line) { fmt::print("{}\n", line); });
    const int status = runApplication();
    setSystemLogSink(nullptr);
    return status;
}
