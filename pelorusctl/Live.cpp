#include "model/PelorusModel.h"
#include "pelorusctl/Commands.h"
#include "pelorusctl/Output.h"
#include "pelorusctl/Screen.h"
#include "pelorusctl/TreeOutput.h"
#include "pelorusctl/TreeView.h"
#include "platform/linux/LinuxPlatform.h"
#include "platform/linux/PortDirectory.h"
#include "platform/linux/SignalWatch.h"
#include "platform/linux/SyslogSink.h"
#include "platform/linux/UncaughtException.h"

#include <QCoreApplication>
#include <QSocketNotifier>
#include <array>
#include <csignal>
#include <cstdlib>
#include <fmt/chrono.h>
#include <unistd.h>

namespace pelorus {

namespace {

std::string updatedText(std::chrono::system_clock::time_point moment)
{
    return fmt::format("Updated {:%Y-%m-%d at %H:%M:%S}",
                       fmt::localtime(std::chrono::system_clock::to_time_t(moment)));
}

bool wantsColours()
{
    const char* refusal = std::getenv("NO_COLOR"); // an empty one refuses nothing (no-color.org)
    return refusal == nullptr || *refusal == '\0';
}

/// The monitor in a terminal: prints every update, or redraws it in place.
class LiveView : public PelorusModelObserver {
public:
    LiveView(const LiveOptions& what, LinuxPlatform& system)
        : options(what), platform(system), model(system, *this), view(wantsColours())
    {
        view.setStatus("Connecting...");
        setLastWords([this](const std::string& exception) {
            screen.leave();
            std::string why;
            if (model.writeRecoverySnapshot(exception, &why))
                fmt::print(stderr, "pelorusctl: ended by {}; what was captured is in {}\n", exception,
                           platform.snapshotDirectory());
            else
                fmt::print(stderr, "pelorusctl: ended by {}; what was captured cannot be saved: {}\n",
                           exception, why);
        });
        platform.dispatchAsyncOnMain([this] { model.restartMonitor(); });
    }
    ~LiveView() override { setLastWords(nullptr); }
    LiveView(const LiveView&) = delete;
    LiveView& operator=(const LiveView&) = delete;

    void openScreen()
    {
        onScreen = true;
        screen.enter();
        redraw();
        keys = std::make_unique<QSocketNotifier>(STDIN_FILENO, QSocketNotifier::Read);
        QObject::connect(keys.get(), &QSocketNotifier::activated, [this] { readKeys(); });
    }

    void updateViewControllerFromModel() override
    {
        const auto root = model.topLevelNodes();
        if (!root)
            return;
        if (!onScreen) {
            if (!print(options.json ? treeJson(*root, model.lastMessageTime()) : treeText(*root)))
                return end(nullptr); // nobody sees what would come
        } else {
            view.setTree(*root);
            if (model.isConnected())
                updateMessage = updatedText(platform.now());
            showStatus();
        }
        if (options.count && ++updates == *options.count)
            end(root.get());
    }

    void connectionChanged() override { showStatus(); }

    void handleSignal(int signal)
    {
        switch (signal) {
        case SIGWINCH:
            redraw();
            break;
        case SIGTSTP: // the terminal is the shell's again until we go on
            screen.leave();
            raise(SIGSTOP);
            break;
        case SIGCONT:
            if (onScreen) { // drawn anew, also when nobody told us of the stop
                screen.leave();
                screen.enter();
                redraw();
            }
            break;
        default:
            end(nullptr);
        }
    }

private:
    void showStatus()
    {
        view.setStatus(model.isConnected() ? updateMessage : "Connecting...");
        redraw();
    }

    void redraw()
    {
        if (!onScreen)
            return;
        const Screen::Size size = screen.size();
        screen.draw(view.lines(size.columns, size.rows));
    }

    void readKeys()
    {
        std::array<char, 256> buffer{};
        const ssize_t count = read(STDIN_FILENO, buffer.data(), buffer.size());
        if (count <= 0) {
            keys->setEnabled(false); // no more keys; signals still end us
            return;
        }
        if (!view.handleKeys({buffer.data(), static_cast<std::size_t>(count)}))
            end(nullptr);
        redraw();
    }

    /// Leaves the terminal as it was, and the last tree below the shell's prompt when one is to stay.
    void end(const PelorusModelNode* last)
    {
        screen.leave();
        if (onScreen && last)
            print(treeText(*last));
        onScreen = false;
        QCoreApplication::quit();
    }

    LiveOptions options;
    LinuxPlatform& platform;
    PelorusModel model;
    Screen screen;
    TreeView view;
    std::unique_ptr<QSocketNotifier> keys;
    std::string updateMessage = "Connecting...";
    bool onScreen = false;
    int updates = 0;
};

} // namespace

int live(const LiveOptions& options)
{
    std::string why;
    if (!PortDirectory::open(why))
        return fail("live", why);
    SyslogSink log("pelorusctl");
    setSystemLogSink(&log);
    LinuxPlatform platform;
    {
        LiveView view(options, platform);
        const SignalWatch signals({SIGINT, SIGTERM, SIGHUP, SIGWINCH, SIGTSTP, SIGCONT},
                                  [&view](int signal) { view.handleSignal(signal); });
        if (!options.json && Screen::isAvailable())
            view.openScreen();
        QCoreApplication::exec();
    }
    setSystemLogSink(nullptr);
    return finishOutput(kSuccess);
}

} // namespace pelorus
