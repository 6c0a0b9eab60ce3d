#include "app/Display.h"

#include <QByteArray>
#include <QString>
#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <fmt/format.h>
#include <string_view>

namespace pelorus {

namespace {

bool isSet(const char* variable)
{
    const char* value = std::getenv(variable);
    return value && *value;
}

[[noreturn]] void endProgram(std::string_view reason)
{
    fmt::print(stderr, "pelorus: {}; \"pelorusctl live\" shows the monitor in a terminal\n", reason);
    std::fflush(nullptr);
    std::_Exit(kNoDisplay);
}

/// What fails while the application is made is the display.
void onMessage(QtMsgType type, const QMessageLogContext&, const QString& text)
{
    if (type == QtFatalMsg)
        endProgram(
            fmt::format("no window can be opened on this display (DISPLAY is \"{}\", WAYLAND_DISPLAY \"{}\")",
                        qgetenv("DISPLAY").toStdString(), qgetenv("WAYLAND_DISPLAY").toStdString()));
    if (type == QtCriticalMsg)
        fmt::print(stderr, "{}\n", text.toStdString());
}

} // namespace

void endWithoutDisplay(int argc, char** argv)
{
    const bool named = isSet("QT_QPA_PLATFORM") || std::any_of(argv, argv + argc, [](std::string_view word) {
                           return word == "-platform" || word == "--platform";
                       });
    if (!named && !isSet("DISPLAY") && !isSet("WAYLAND_DISPLAY"))
        endProgram("there is no display: neither DISPLAY nor WAYLAND_DISPLAY is set");
    qInstallMessageHandler(onMessage);
}

void displayIsThere()
{
    qInstallMessageHandler(nullptr);
}

} // namespace pelorus
