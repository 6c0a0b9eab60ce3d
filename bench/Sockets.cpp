// Messages from another process over the log channel's socket to the model, with and without decoding.

#include "bench/MessageStream.h"
#include "model/PelorusModel.h"
#include "platform/linux/LinuxPlatform.h"

#include <QCoreApplication>
#include <QEventLoop>
#include <benchmark/benchmark.h>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <sys/socket.h>
#include <sys/un.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

using namespace pelorus;

constexpr std::size_t kMessages = 200'000;

std::vector<std::byte> framed(const bench::MessageStream& stream)
{
    std::vector<std::byte> frames;
    for (std::size_t index = 0; index < stream.size(); ++index) {
        const auto message = stream[index];
        std::byte header[16] = {};
        for (std::size_t place = 0; place < 4; ++place)
            header[place] = static_cast<std::byte>(message.size() >> (8 * place));
        frames.insert(frames.end(), header, header + sizeof header);
        frames.insert(frames.end(), message.begin(), message.end());
    }
    return frames;
}

/// A process that connects to the port and writes everything as fast as it is taken.
pid_t startSender(const std::string& path, const std::vector<std::byte>& frames)
{
    const pid_t child = fork();
    if (child != 0)
        return child;
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::snprintf(address.sun_path, sizeof address.sun_path, "%s", path.c_str());
    const int descriptor = socket(AF_UNIX, SOCK_STREAM, 0);
    if (connect(descriptor, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0)
        _exit(1);
    for (std::size_t sent = 0; sent < frames.size();) {
        const ssize_t count = write(descriptor, frames.data() + sent, frames.size() - sent);
        if (count <= 0)
            _exit(1);
        sent += static_cast<std::size_t>(count);
    }
    char none = 0;
    [[maybe_unused]] const ssize_t closed = read(descriptor, &none, 1); // until the receiver is done
    _exit(0);
}

void receive(benchmark::State& run)
{
    const bench::MessageStream stream("Osprey LTE", kMessages);
    const auto frames = framed(stream);
    LinuxPlatform platform(PELORUS_SOURCE_DIR "/resources");
    const auto generator = LogGenerator::generatorFromTechnology(platform, "Osprey LTE");
    State state;
    const bool decodes = run.range(0) != 0;
    for ([[maybe_unused]] auto _ : run) {
        std::size_t received = 0;
        auto local =
            platform.createLocalMessagePort("bench", [&](std::int32_t, std::span<const std::byte> data) {
                if (decodes)
                    generator->updateState(state, data);
                ++received;
                return std::optional<Bytes>();
            });
        platform.deliverOnMainQueue(*local.port);
        const pid_t sender =
            startSender(std::string(std::getenv("PELORUS_PORT_DIRECTORY")) + "/bench", frames);
        while (received < stream.size())
            QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
        platform.invalidatePort(*local.port);
        int status = 0;
        waitpid(sender, &status, 0);
        if (status != 0)
            run.SkipWithError("the sender failed");
        generator->generateLogUsingState(state);
    }
    run.SetLabel(decodes ? "decoded" : "counted");
    run.SetItemsProcessed(run.iterations() * static_cast<std::int64_t>(stream.size()));
    run.SetBytesProcessed(run.iterations() * static_cast<std::int64_t>(stream.byteCount()));
}
BENCHMARK(receive)->DenseRange(0, 1)->UseRealTime()->Unit(benchmark::kMillisecond);

} // namespace

int main(int argc, char** argv)
{
    std::string directory = (std::filesystem::temp_directory_path() / "pelorus-bench-XXXXXX").string();
    if (!mkdtemp(directory.data()))
        return 1;
    setenv("PELORUS_PORT_DIRECTORY", directory.c_str(), 1);
    const QCoreApplication application(argc, argv);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    std::filesystem::remove_all(directory);
    return 0;
}
