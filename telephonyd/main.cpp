#include "platform/PrintableText.h"
#include "platform/linux/PassedSockets.h"
#include "platform/linux/SignalWatch.h"
#include "telephonyd/Options.h"
#include "telephonyd/modem/ModemFeed.h"
#include "telephonyd/server/ReplaySource.h"
#include "telephonyd/server/SimulationSource.h"
#include "telephonyd/server/TelephonyServer.h"

#include <QCoreApplication>
#include <filesystem>
#include <fmt/format.h>
#include <sys/resource.h>

using namespace pelorus;

namespace {

void report(const std::string& line)
{
    fmt::print(stderr, "{}\n", printable(line)); // clients choose the names of their ports
}

int fail(const std::string& line)
{
    report("pelorus-telephonyd: " + line);
    return 1;
}

/// Every channel takes three descriptors and perhaps a recording; the usual limit is too near for 256.
void raiseDescriptorLimit()
{
    rlimit limit = {};
    if (::getrlimit(RLIMIT_NOFILE, &limit) == 0) {
        limit.rlim_cur = limit.rlim_max;
        ::setrlimit(RLIMIT_NOFILE, &limit);
    }
}

TelephonyServer::Settings settingsFor(const Options& options)
{
    TelephonyServer::Settings settings;
    settings.technology = options.technology.value_or(options.simulate.value_or(""));
    settings.loop = options.loop;
    settings.report = report;
    settings.pace = options.rate ? Pace::rate(*options.rate) : Pace::ownTiming(options.speed);
    if (options.replay)
        settings.makeSource = ReplaySource::factory(*options.replay, report);
    else if (options.simulate)
        settings.makeSource = SimulationSource::factory(*options.simulate, options.seed);
    return settings;
}

std::unique_ptr<ModemFeed> feedFor(const Options& options)
{
    if (!options.modem)
        return nullptr;
    ModemFeed::Settings settings;
    settings.modem = QString::fromStdString(*options.modem);
    settings.report = report;
    return std::make_unique<ModemFeed>(std::move(settings));
}

bool isSameFile(const std::string& one, const std::string& other)
{
    std::error_code ignored; // a file that is not there yet is none
    return std::filesystem::equivalent(one, other, ignored);
}

/// On the socket that the service manager passed, or on one of its own.
bool listen(TelephonyServer& server, std::string& why)
{
    std::vector<FileDescriptor> passed = takePassedSockets();
    if (passed.empty())
        return server.listen(why) == PortListener::Outcome::listening;
    if (passed.size() > 1) {
        why = fmt::format("{} sockets were passed, there is use for one", passed.size());
        return false;
    }
    return server.listenOn(std::move(passed.front()), why) == PortListener::Outcome::listening;
}

/// Leaves the modem as it was found, unless that takes too long.
void end(ModemFeed* feed)
{
    constexpr std::chrono::seconds patience(1);
    QTimer::singleShot(patience, QCoreApplication::instance(), &QCoreApplication::quit);
    if (feed)
        feed->finish(&QCoreApplication::quit);
    else
        QCoreApplication::quit();
}

int serve(const Options& options)
{
    std::string why;
    const auto feed = feedFor(options); // outlives the server
    const SignalWatch signals({SIGINT, SIGTERM}, [&feed](int) { end(feed.get()); });
    TelephonyServer::Settings settings = settingsFor(options);
    if (feed) {
        settings.makeSource = feed->sourceFactory();
        settings.pace = Pace::ownTiming(0); // it is now that it tells of
    } else if (!settings.makeSource(why)) { // rather now than when the first client comes
        return fail(why);
    }
    if (options.replay && options.record && isSameFile(*options.replay, *options.record))
        return fail(fmt::format("{}: cannot be replayed and recorded to at once", *options.record));

    const auto directory = PortDirectory::open(why);
    if (!directory)
        return fail(why);
    std::unique_ptr<MessageRecorder> recorder; // outlives the server
    TelephonyServer server(*directory, std::move(settings));
    if (!listen(server, why))
        return fail(why);
    if (options.record) { // not before it is clear that no other server writes it
        recorder = MessageRecorder::create(*options.record, report, why);
        if (!recorder)
            return fail(why);
        server.recordTo(*recorder);
    }
    if (feed)
        feed->start({.technologyChanged =
                         [&](const std::string& technology) {
                             server.changeTechnology(
                                 technology.empty() ? technology : options.technology.value_or(technology));
                         },
                     .asked = [&server] { server.acceptClients(); }});
    else
        server.acceptClients();
    report(fmt::format("listening on {}", server.path()));
    const int status = QCoreApplication::exec();
    const bool recorded = !recorder || recorder->finish(); // why not was said when it happened
    return recorded ? status : 1;
}

} // namespace

int main(int argumentCount, char** arguments)
{
    int status = 0;
    const auto options = Options::parse(argumentCount, arguments, status);
    if (!options)
        return status;
    raiseDescriptorLimit();
    QCoreApplication application(argumentCount, arguments);
    return serve(*options);
}
