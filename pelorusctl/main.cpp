#include "LogGenerator/LogGenerator.h"
#include "pelorusctl/Commands.h"
#include "pelorusctl/Output.h"
#include "platform/linux/UncaughtException.h"

#include <CLI/CLI.hpp>
#include <QCoreApplication>
#include <clocale>
#include <cmath>
#include <functional>

namespace {

using namespace pelorus;

const CLI::Validator kTechnology(
    [](const std::string& text) {
        const auto known = LogGenerator::technologies();
        if (std::find(known.begin(), known.end(), text) != known.end())
            return std::string();
        std::string names;
        for (const std::string_view name : known)
            names.append(names.empty() ? "\"" : ", \"").append(name).append("\"");
        return "\"" + text + "\" is no technology; there are " + names;
    },
    "TECHNOLOGY");

const CLI::Validator kSeconds(
    [](const std::string& text) {
        double seconds = 0;
        return CLI::detail::lexical_cast(text, seconds) && std::isfinite(seconds) && seconds >= 1e-9
                   ? std::string()
                   : "\"" + text + "\" is no number of seconds above 0";
    },
    "SECONDS");

void addTechnology(CLI::App& command, std::string& technology)
{
    command.add_option("--technology", technology, "Technology identifier, for example \"Osprey LTE\"")
        ->required()
        ->check(kTechnology);
}

} // namespace

int main(int argc, char** argv)
{
    const QCoreApplication application(argc, argv);
    QCoreApplication::setApplicationName("pelorusctl");
    std::setlocale(LC_NUMERIC,
                   "C"); // which Qt has set to the user's; an interval has a point in any language
    reportUncaughtException();

    CLI::App arguments("Cellular field-test monitor for the terminal", "pelorusctl");
    arguments.set_version_flag("--version", "pelorusctl " PELORUS_VERSION);
    arguments.require_subcommand(1);
    std::function<int()> run;

    LiveOptions liveOptions;
    CLI::App* liveCommand = arguments.add_subcommand("live", "Show the handset of the telephony server");
    liveCommand->add_flag("--json", liveOptions.json, "One line of JSON an update");
    liveCommand->add_option("--count", liveOptions.count, "End after so many updates")
        ->check(CLI::PositiveNumber);
    liveCommand->callback([&] { run = [&] { return live(liveOptions); }; });

    DecodeOptions decodeOptions;
    CLI::App* decodeCommand = arguments.add_subcommand("decode", "Decode a recording");
    addTechnology(*decodeCommand, decodeOptions.technology);
    decodeCommand->add_flag("--json", decodeOptions.json, "One line of JSON a refresh");
    decodeCommand
        ->add_option("--every", decodeOptions.everySeconds, "Refresh each so many seconds of recorded time")
        ->check(kSeconds);
    decodeCommand->add_option("--resources", decodeOptions.resources, "Directory of the display templates");
    decodeCommand->add_option("--system-log", decodeOptions.systemLog,
                              "File for the system log; - is standard error");
    decodeCommand->add_option("--save", decodeOptions.save, "Write a snapshot file at the end");
    decodeCommand->add_option("--description", decodeOptions.description, "Description in the snapshot file");
    decodeCommand
        ->add_option("RECORDING", decodeOptions.recording, "pcap or pcapng file, snapshot, or DLF file")
        ->required();
    decodeCommand->callback([&] { run = [&] { return decode(decodeOptions); }; });

    SnapshotOptions snapshotOptions;
    CLI::App* snapshotCommand = arguments.add_subcommand("snapshot", "Tell what a snapshot file holds");
    snapshotCommand->add_flag("--json", snapshotOptions.json, "One JSON object");
    snapshotCommand->add_option("--extract-dlf", snapshotOptions.extractDlf, "Write the snapshot's DLF file");
    snapshotCommand->add_option("SNAPSHOT", snapshotOptions.snapshot, "Snapshot file")->required();
    snapshotCommand->callback([&] { run = [&] { return snapshot(snapshotOptions); }; });

    StartCommandOptions startOptions;
    CLI::App* startCommandCommand =
        arguments.add_subcommand("start-command", "Print the command that starts the log stream");
    addTechnology(*startCommandCommand, startOptions.technology);
    startCommandCommand->add_option("--resources", startOptions.resources,
                                    "Directory of the display templates");
    startCommandCommand->callback([&] { run = [&] { return startCommand(startOptions); }; });

    try {
        arguments.parse(argc, argv);
    } catch (const CLI::ParseError& error) {
        return arguments.exit(error) == 0 ? kSuccess : kWrongUsage;
    }
    return run();
}
