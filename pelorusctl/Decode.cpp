#include "model/SnapshotFile.h"
#include "pelorusctl/Commands.h"
#include "pelorusctl/OfflineMonitor.h"
#include "pelorusctl/Output.h"
#include "pelorusctl/TreeOutput.h"
#include "platform/PropertyList.h"
#include "platform/linux/FileLogSink.h"
#include "platform/linux/Files.h"
#include "platform/linux/LinuxPlatform.h"

#include <cerrno>
#include <cmath>
#include <cstring>

namespace pelorus {

namespace {

std::optional<std::chrono::nanoseconds> interval(const DecodeOptions& options)
{
    if (!options.everySeconds)
        return std::nullopt;
    // Longer than any recording is as good as never, and does not overflow.
    constexpr double kLongest = 1e9;
    return std::chrono::nanoseconds(std::llround(std::min(*options.everySeconds, kLongest) * 1e9));
}

/// The decoders' last lines come when they are destroyed: the sink stays theirs until after that.
class ChosenSink {
public:
    explicit ChosenSink(SystemLogSink* sink) { setSystemLogSink(sink); }
    ~ChosenSink() { setSystemLogSink(nullptr); }
    ChosenSink(const ChosenSink&) = delete;
    ChosenSink& operator=(const ChosenSink&) = delete;
};

int decodeRecording(RecordingReader& recording, const DecodeOptions& options)
{
    LinuxPlatform platform(options.resources);
    OfflineMonitor monitor(LogGenerator::generatorFromTechnology(platform, options.technology),
                           interval(options),
                           [&options](const PelorusModelNode& root, std::optional<RecordedTime> lastMessage) {
                               print(options.json ? treeJson(root, lastMessage) : treeText(root));
                           });
    if (options.save.empty())
        monitor.saveNothing();
    RecordedMessage message;
    RecordingReader::Next next{};
    while ((next = recording.next(message)) == RecordingReader::Next::message)
        monitor.receive(message);
    monitor.finish(); // of a broken recording, what came before the break is shown and saved all the same

    int status = kSuccess;
    if (next == RecordingReader::Next::failed)
        status = fail(options.recording, recording.why());
    if (!options.save.empty()) {
        const Value content =
            snapshotFileContent(dateText(platform.now()), monitor.saveContents(), options.description);
        errno = 0;
        const auto bytes = serializePropertyList(content);
        if (!bytes || !replaceWholeFile(options.save, *bytes))
            status = fail(options.save, errno ? std::strerror(errno) : "cannot be written");
    }
    return status;
}

} // namespace

int decode(const DecodeOptions& options)
{
    std::string why;
    const auto recording = RecordingReader::open(options.recording, why);
    if (!recording)
        return fail(options.recording, why);
    if (!options.resources.empty() && !isDirectory(options.resources))
        return fail(options.resources, "no directory");
    if (isSameFile(options.systemLog, options.recording)) // it would be emptied before it is read
        return fail(options.systemLog, "is the recording, and cannot be the system log too");
    std::unique_ptr<FileLogSink> log;
    if (!options.systemLog.empty() && !(log = FileLogSink::open(options.systemLog, why)))
        return fail(options.systemLog, why);
    const ChosenSink chosenSink(log.get());
    int status = decodeRecording(*recording, options);
    if (log && log->error())
        status = fail(options.systemLog, std::strerror(log->error()));
    return finishOutput(status);
}

} // namespace pelorus
