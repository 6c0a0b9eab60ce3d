#include "telephonyd/Options.h"

#include <CLI/CLI.hpp>
#include <array>
#include <charconv>
#include <cmath>
#include <fmt/format.h>

namespace pelorus {

namespace {

constexpr int kWrongUsage = 2;
constexpr std::array<std::string_view, 5> kTechnologies = {"IFX", "Osprey GSM", "Osprey CDMA", "Osprey LTE",
                                                           "Osprey UTRAN2"};

std::string knownTechnology(const std::string& text)
{
    if (std::find(kTechnologies.begin(), kTechnologies.end(), text) != kTechnologies.end())
        return {};
    return fmt::format("\"{}\" is none of {}", text, fmt::join(kTechnologies, ", "));
}

// CLI11's own checks let "nan" and negative seeds through.

std::string finite(const std::string& text, bool zeroToo)
{
    double number = 0;
    if (CLI::detail::lexical_cast(text, number) && std::isfinite(number) &&
        (number > 0 || (zeroToo && number == 0)))
        return {};
    return fmt::format("\"{}\" is no number {} 0", text, zeroToo ? "of at least" : "above");
}

std::string notNegative(const std::string& text)
{
    return finite(text, true);
}

std::string positive(const std::string& text)
{
    return finite(text, false);
}

std::string natural(const std::string& text)
{
    std::uint64_t number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error == std::errc() && end == text.data() + text.size())
        return {};
    return fmt::format("\"{}\" is no whole number below 2^64", text);
}

void describe(CLI::App& command, Options& options)
{
    auto& source = *command.add_option_group("Source", "Where log messages come from (just one)");
    auto* simulate =
        source.add_option("--simulate", options.simulate, "play a made-up handset of technology T")
            ->type_name("T")
            ->check(knownTechnology);
    auto* replay = source.add_option("--replay", options.replay, "play a recording")->type_name("RECORDING");
    source
        .add_option("--modem", options.modem,
                    "read the machine's modem: the first one, or the one of that device identifier")
        ->type_name("ID")
        ->expected(0, 1);
    source.require_option(1);

    auto* technology =
        command.add_option("--technology", options.technology, "answer to clients that ask what there is")
            ->type_name("T")
            ->check(knownTechnology);
    replay->needs(technology);
    command.add_option("--speed", options.speed, "replay X times as fast; 0: as fast as the client takes it")
        ->type_name("X")
        ->check(notNegative)
        ->needs(replay);
    command.add_flag("--loop", options.loop, "replay again and again")->needs(replay);
    command.add_option("--rate", options.rate, "simulate N messages a second (default: as a handset does)")
        ->type_name("N")
        ->check(positive)
        ->needs(simulate);
    command.add_option("--seed", options.seed, "simulate life number N (default: 1)")
        ->type_name("N")
        ->check(natural)
        ->needs(simulate);
    command.add_option("--record", options.record, "write every streamed message to FILE")->type_name("FILE");
}

} // namespace

std::optional<Options> Options::parse(int argumentCount, char** arguments, int& status)
{
    CLI::App command("Telephony server for machines that have none.", "pelorus-telephonyd");
    Options options;
    describe(command, options);
    command.set_version_flag("--version", "pelorus-telephonyd " PELORUS_VERSION);
    try {
        command.parse(argumentCount, arguments);
    } catch (const CLI::ParseError& error) {
        status = command.exit(error) == 0 ? 0 : kWrongUsage;
        return std::nullopt;
    }
    return options;
}

} // namespace pelorus
