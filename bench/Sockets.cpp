// Messages from another process over the log channel's socket to the model, with and without decoding, beside
// what a bare socket and decoding a recording take. The comparisons count the processor time of the sender
// and the receiver together, and are meant to run on one core, where that is what a message takes.

#include "bench/FrameSender.h"
#include "bench/Paired.h"
#include "bench/RawReceiver.h"
#include "model/PelorusModel.h"
#include "platform/linux/LinuxPlatform.h"
#include "platform/recording/PcapRecording.h"

#include <QCoreApplication>
#include <QEventLoop>
#include <cstdlib>
#include <filesystem>

namespace {

using namespace pelorus;

constexpr std::size_t kMessages = 200'000;
constexpr std::size_t kAllAtOnce = kMessages;

std::string socketPath(const char* name)
{
    return std::string(std::getenv("PELORUS_PORT_DIRECTORY")) + '/' + name;
}

/// What a handset sends, and both ways of taking it.
class Receiver {
public:
    /// Over a local port, from a process that writes so many frames at once. False when some were lost.
    bool receive(std::size_t framesPerWrite, bool decodes)
    {
        std::size_t received = 0;
        auto local =
            platform.createLocalMessagePort("bench", [&](std::int32_t, std::span<const std::byte> data) {
                if (decodes)
                    generator->updateState(state, data);
                ++received;
                return std::optional<Bytes>();
            });
        platform.deliverOnMainQueue(*local.port);
        sender.start(socketPath("bench"), framesPerWrite);
        while (received < stream.size())
            QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
        platform.invalidatePort(*local.port);
        generator->generateLogUsingState(state);
        return sender.succeeded();
    }

    bool receiveRaw()
    {
        sender.start(socketPath("raw"), 1);
        const bool all = raw.receive(stream.size()) == stream.size();
        return sender.succeeded() && all;
    }

    /// As pelorusctl decodes a recording of the same messages. False when some were lost.
    bool decodeRecording()
    {
        if (!std::filesystem::exists(recordingPath()))
            writeRecording();
        std::string why;
        const auto recording = RecordingReader::open(recordingPath(), why);
        std::size_t received = 0;
        RecordedMessage message;
        while (recording && recording->next(message) == RecordingReader::Next::message) {
            generator->updateState(state, message.bytes);
            ++received;
        }
        generator->generateLogUsingState(state);
        return received == stream.size();
    }

    /// Of both processes' work.
    double seconds() const { return bench::processorSeconds() + sender.seconds(); }

    const bench::MessageStream stream = bench::MessageStream("Osprey LTE", kMessages);

private:
    static std::string recordingPath() { return socketPath("recording"); }
    void writeRecording() const
    {
        std::string why;
        const auto writer = RecordingWriter::create(recordingPath(), why);
        for (std::size_t index = 0; writer && index < stream.size(); ++index)
            writer->write({RecordedTime(), stream[index]});
    }

    const bench::Frames frames = bench::Frames(stream);
    bench::FrameSender sender = bench::FrameSender(frames);
    bench::RawReceiver raw = bench::RawReceiver(socketPath("raw"));
    LinuxPlatform platform = LinuxPlatform(PELORUS_SOURCE_DIR "/resources");
    std::unique_ptr<LogGenerator> generator = LogGenerator::generatorFromTechnology(platform, "Osprey LTE");
    State state;
};

void receive(benchmark::State& run)
{
    Receiver receiver;
    const bool decodes = run.range(0) != 0;
    for ([[maybe_unused]] auto _ : run)
        if (!receiver.receive(kAllAtOnce, decodes))
            run.SkipWithError("the sender failed");
    run.SetLabel(decodes ? "decoded" : "counted");
    run.SetItemsProcessed(run.iterations() * static_cast<std::int64_t>(receiver.stream.size()));
    run.SetBytesProcessed(run.iterations() * static_cast<std::int64_t>(receiver.stream.byteCount()));
}
BENCHMARK(receive)->DenseRange(0, 1)->UseRealTime()->Unit(benchmark::kMillisecond);

/// A frame a write: the port, counting, against read(2), counting.
void framesBesideRaw(benchmark::State& run)
{
    Receiver receiver;
    bool all = true;
    bench::compare(
        run, [&] { return receiver.seconds(); }, receiver.stream.size(),
        [&] { all = receiver.receive(1, false) && all; }, [&] { all = receiver.receiveRaw() && all; });
    if (!all)
        run.SkipWithError("frames were lost");
}
BENCHMARK(framesBesideRaw)->UseManualTime()->Iterations(15)->Unit(benchmark::kMillisecond);

/// 64 frames a write, decoded, against the same messages decoded from a recording.
void batchesBesideRecording(benchmark::State& run)
{
    Receiver receiver;
    bool all = true;
    bench::compare(
        run, [&] { return receiver.seconds(); }, receiver.stream.size(),
        [&] { all = receiver.receive(64, true) && all; }, [&] { all = receiver.decodeRecording() && all; });
    if (!all)
        run.SkipWithError("frames were lost");
}
BENCHMARK(batchesBesideRecording)->UseManualTime()->Iterations(15)->Unit(benchmark::kMillisecond);

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
