#include "platform/linux/SignalWatch.h"
#include "telephonyd/Options.h"
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
    fmt::print(stderr, "{}\n", line);
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
    settings.makeSource = options.replay ? ReplaySource::factory(*options.replay, report)
                                         : SimulationSource::factory(*options.simulate, options.seed);
    return settings;
}

bool isSameFile(const std::string& one, const std::string& other)
{
    std::error_code ignored; // a file that is not there yet is none
    return std::filesystem::equivalent(one, other, ignored);
}

int serve(const Options& options)
{
    std::string why;
    TelephonyServer::Settings settings = settingsFor(options);
    if (!settings.makeSource(why)) // rather now than when the first client comes
        return fail(why);
    if (options.replay && options.record && isSameFile(*options.replay, *options.record))
        return fail(fmt::format("{}: cannot be replayed and recorded to at once", *options.record));

    const auto directory = PortDirectory::open(why);
    if (!directory)
        return fail(why);
    std::unique_ptr<MessageRecorder> recorder; // outlives the server
    TelephonyServer server(*directory, std::move(settings));
    if (server.listen(why) != PortListener::Outcome::listening)
        return fail(why);
    if (options.record) { // not before it is clear that no other server writes it
        recorder = MessageRecorder::create(*options.record, report, why);
        if (!recorder)
            return fail(why);
        server.recordTo(*recorder);
    }
    server.acceptClients();
    report(fmt::format("listening on {}", server.path()));
    return QCoreApplication::exec();
}

} // namespace

int main(int argumentCount, char** arguments)
{
    int status = 0;
    const auto options = Options::parse(argumentCount, arguments, status);
    if (!options)
        return status;
    if (options->modem)
        return fail("--modem: this version cannot read a modem");
    raiseDescriptorLimit();
    QCoreApplication application(argumentCount, arguments);
    const SignalWatch signals({SIGINT, SIGTERM}, [](int) { QCoreApplication::quit(); });
    return serve(*options);
}
