// Writes a recording of a simulated handset, the same for the same arguments: what bench/report feeds to the
// programs.

#include "bench/MessageStream.h"
#include "platform/recording/PcapRecording.h"

#include <CLI/CLI.hpp>
#include <cstdio>
#include <map>
#include <optional>

namespace {

using namespace pelorus;

constexpr std::size_t kLogType = 0;
constexpr std::size_t kLogCode = 3;

struct Options {
    std::string technology;
    std::size_t count = 0;
    std::string path;
    bool unknown = false;
    bool rounds = false;
};

std::size_t codeOf(std::span<const std::byte> message)
{
    return std::to_integer<std::size_t>(message[kLogCode]) |
           std::to_integer<std::size_t>(message[kLogCode + 1]) << 8 |
           std::to_integer<std::size_t>(message[kLogType]) << 16;
}

/// What a handset logs, one message of each log code in turn; those of rare codes come again and again.
class Rounds {
public:
    explicit Rounds(Simulation& simulation)
    {
        constexpr std::size_t pool = 100'000;
        SimulatedMessage message;
        for (std::size_t index = 0; index < pool; ++index) {
            simulation.next(message);
            codes[codeOf(message.bytes)].emplace_back(message.bytes.begin(), message.bytes.end());
        }
        code = codes.begin();
    }

    void next(std::vector<std::byte>& message)
    {
        message = code->second[number % code->second.size()];
        if (++code == codes.end()) {
            code = codes.begin();
            ++number;
        }
    }
    /// Of whole rounds so far.
    std::size_t count() const { return number; }

private:
    std::map<std::size_t, std::vector<std::vector<std::byte>>> codes;
    std::map<std::size_t, std::vector<std::vector<std::byte>>>::const_iterator code;
    std::size_t number = 0;
};

/// A baseband's packet of a log code that no section knows.
void makeUnknown(std::vector<std::byte>& message)
{
    message[kLogType] = std::byte{1};
    message[kLogCode] = std::byte{0x01};
    message[kLogCode + 1] = std::byte{0x0F};
}

int write(const Options& options)
{
    std::string why;
    const auto writer = RecordingWriter::create(options.path, why);
    const auto simulation = Simulation::create(options.technology, 1, {});
    if (!writer || !simulation) {
        std::fprintf(stderr, "bench_WriteRecording: %s\n", writer ? "no such technology" : why.c_str());
        return 1;
    }
    const RecordedTime start = std::chrono::sys_days(std::chrono::year(2026) / 1 / 1);
    std::optional<Rounds> rounds;
    if (options.rounds)
        rounds.emplace(*simulation);
    SimulatedMessage message;
    std::vector<std::byte> bytes;
    bool written = true;
    for (std::size_t index = 0; written && index < options.count; ++index) {
        RecordedTime time = start;
        if (rounds) {
            time += std::chrono::seconds(rounds->count());
            rounds->next(bytes);
        } else {
            simulation->next(message);
            time += message.time;
            bytes.assign(message.bytes.begin(), message.bytes.end());
        }
        if (options.unknown)
            makeUnknown(bytes);
        written = writer->write({time, bytes});
    }
    if (!written || !writer->flush()) {
        std::fprintf(stderr, "bench_WriteRecording: %s cannot be written\n", options.path.c_str());
        return 1;
    }
    return 0;
}

} // namespace

int main(int argc, char** argv)
{
    Options options;
    CLI::App app("Writes a recording of a simulated handset.");
    app.add_option("technology", options.technology, "of the handset")->required();
    app.add_option("count", options.count, "of messages")->required()->check(CLI::Range(1, 10'000'000));
    app.add_option("file", options.path, "to write")->required();
    app.add_flag("--unknown", options.unknown, "with log codes that nobody decodes");
    app.add_flag("--rounds", options.rounds,
                 "one of each log code at the same second: --every 0.5 then shows every message once");
    CLI11_PARSE(app, argc, argv);
    return write(options);
}
