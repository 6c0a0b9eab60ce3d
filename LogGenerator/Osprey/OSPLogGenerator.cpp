#include "LogGenerator/Osprey/OSPLogGenerator.h"

#include "LogGenerator/Osprey/VersionReport.h"
#include "platform/SystemLog.h"

#include <fmt/format.h>

namespace pelorus {

namespace {

constexpr int kMostSevere = 16; // user facility, most severe level

std::uint64_t packedTime(Platform& platform)
{
    const auto seconds = std::chrono::floor<std::chrono::seconds>(platform.now()).time_since_epoch().count();
    const Platform::LocalZone zone = platform.localZone();
    const auto minutes = static_cast<std::int16_t>(zone.offset.count() / 60);
    return std::uint64_t{static_cast<std::uint32_t>(seconds)} |
           std::uint64_t{static_cast<std::uint16_t>(minutes)} << 32 |
           std::uint64_t{zone.daylightSaving ? 1U : 0U} << 48;
}

} // namespace

std::shared_ptr<Array> OSPLogGenerator::getSaveContentsFromState(const State& state) const
{
    auto contents = historyOf(state);
    if (auto dlf = generateDlfFromState(state)) {
        const std::string description = fmt::format("DLF binary ({} bytes)", dlf->size());
        contents->elements.emplace_back(
            makeDictionary({{"Description", description}, {"DLF", makeData(std::move(*dlf))}}));
    }
    return contents;
}

std::optional<Bytes> OSPLogGenerator::generateDlfFromState(const State& state) const
{
    Bytes dlf(kVersionReportLength);
    const auto version = platform.bundleVersion();
    std::uint32_t written = 0;
    const std::uint32_t result = KilnDLFAddVersionReport(dlf, static_cast<std::uint32_t>(dlf.size()), written,
                                                         1, 1, version ? "Pelorus " + *version : "(none)",
                                                         "EXECUTABLE_NAME", // stands so in every file
                                                         __DATE__ " " __TIME__, packedTime(platform));
    if (result != 0) {
        systemLog(kMostSevere, "Could not write DLF header (result=%d)", static_cast<int>(result));
        return std::nullopt;
    }
    const Value history = state.at("History");
    if (!history.array())
        return dlf;
    for (const Value& snapshot : history.array()->elements) {
        const Value* messages = snapshot.dictionary() ? snapshot.dictionary()->find("DisplayState") : nullptr;
        if (!messages)
            continue;
        const std::vector<std::byte>* bytes = messages->data();
        if (!bytes) {
            systemLog(kMostSevere, "Got wrong class writing history to DLF; aborting writing the DLF file");
            return std::nullopt;
        }
        // Only the first log-type byte of each snapshot goes; those of the messages behind it stay: meant.
        if (bytes->size() >= 2)
            dlf.insert(dlf.end(), bytes->begin() + 1, bytes->end());
    }
    return dlf;
}

void OSPLogGenerator::handOverRawMessages(State& state)
{
    const std::size_t size = binData.size();
    auto messages = std::make_shared<Bytes>(std::move(binData));
    state.set(Label("DisplayState"), Data(messages));
    handedOver.push_back(std::move(messages));
    binData = emptyBuffer(size);
}

// Fresh memory costs the kernel a tenth of what decoding the messages takes that are written there.
Bytes OSPLogGenerator::emptyBuffer(std::size_t usualSize)
{
    Bytes buffer;
    std::erase_if(handedOver, [&](const std::shared_ptr<Bytes>& messages) {
        if (messages.use_count() > 1)
            return false;
        if (messages->capacity() <= 4 * usualSize && messages->capacity() > buffer.capacity())
            buffer = std::move(*messages);
        return true;
    });
    buffer.clear();
    buffer.reserve(usualSize);
    return buffer;
}

} // namespace pelorus
