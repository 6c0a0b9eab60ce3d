// Recordings from anybody, as `pelorusctl decode` and `pelorusctl snapshot` take them. What decode saves,
// snapshot reads.
//
// The input: a byte of options, and the file.

#include "platform/recording/Recording.h"
#include "LogGenerator/Osprey/ArrayOutOfBoundsException.h"
#include "LogGenerator/Osprey/GSM/SimInfo.h"
#include "fuzz/AcceptedEnd.h"
#include "fuzz/Input.h"
#include "fuzz/Require.h"
#include "pelorusctl/Commands.h"

#include <QCoreApplication>
#include <array>
#include <cstdio>
#include <fmt/format.h>
#include <sys/mman.h>
#include <unistd.h>

using namespace pelorus;
using namespace pelorus::fuzz;

namespace {

constexpr std::array kTechnologies{"Osprey LTE", "Osprey GSM", "Osprey UTRAN2", "Osprey CDMA", "IFX"};
enum Option : unsigned { readsSnapshot = 0x10, json = 0x20, everyHalfSecond = 0x40, logsAndSaves = 0x80 };

/// A file that has a path but stands in memory only.
class MemoryFile {
public:
    explicit MemoryFile(std::span<const std::byte> content) : descriptor(memfd_create("fuzz", MFD_CLOEXEC))
    {
        require(write(descriptor, content.data(), content.size()) == static_cast<ssize_t>(content.size()),
                "a file can be made");
    }
    ~MemoryFile() { close(descriptor); }
    MemoryFile(const MemoryFile&) = delete;
    MemoryFile& operator=(const MemoryFile&) = delete;
    std::string path() const { return fmt::format("/proc/self/fd/{}", descriptor); }

private:
    int descriptor;
};

/// Whether one of the messages may end the program that way.
bool holdsReasonFor(AcceptedEnd end, const std::string& technology, const std::string& recording)
{
    std::string why;
    const auto reader = RecordingReader::open(recording, why);
    RecordedMessage message;
    while (reader && reader->next(message) == RecordingReader::Next::message)
        if (acceptedEnd(technology, message.bytes) == end)
            return true;
    return false;
}

/// The exit status; nothing for a program end that one of the messages requires.
std::optional<int> decodeFile(const DecodeOptions& options)
{
    try {
        return decode(options);
    } catch (const ArrayOutOfBoundsException&) {
        if (!holdsReasonFor(AcceptedEnd::arrayOutOfBounds, options.technology, options.recording))
            throw;
    } catch (const LogCode_0xFF0000::UnknownDataException&) {
        if (!holdsReasonFor(AcceptedEnd::unknownData, options.technology, options.recording))
            throw;
    }
    return std::nullopt;
}

} // namespace

extern "C" int LLVMFuzzerInitialize(int* argumentCount, char*** arguments)
{
    static const QCoreApplication application(*argumentCount, *arguments);
    // What the commands print is of no interest here. libFuzzer keeps its own way to standard error.
    stdout = std::fopen("/dev/null", "we");
    stderr = stdout;
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    Input input(data, size);
    const unsigned options = input.byte();
    const MemoryFile file(input.take(size));
    if (options & readsSnapshot) {
        const bool extracts = options & logsAndSaves;
        snapshot({.snapshot = file.path(),
                  .json = (options & json) != 0,
                  .extractDlf = extracts ? "/dev/null" : ""});
        return 0;
    }
    DecodeOptions decoding;
    decoding.technology = kTechnologies[(options & 0xF) % kTechnologies.size()];
    decoding.recording = file.path();
    decoding.json = options & json;
    if (options & everyHalfSecond)
        decoding.everySeconds = 0.5;
    decoding.resources = PELORUS_SOURCE_DIR "/resources";
    const MemoryFile saved({});
    if (options & logsAndSaves) {
        decoding.systemLog = "/dev/null";
        decoding.save = saved.path();
    }
    const auto status = decodeFile(decoding);
    if (status == 0 && !decoding.save.empty())
        require(snapshot({.snapshot = saved.path()}) == 0, "what decode saved is a snapshot");
    return 0;
}
