#include "platform/recording/SnapshotRecording.h"

#include "platform/PropertyList.h"
#include "platform/recording/RawMessages.h"

#include <algorithm>
#include <ctime>
#include <fmt/format.h>
#include <string_view>

namespace pelorus {

bool SnapshotRecording::looksLikeOne(std::span<const std::byte> start)
{
    std::string_view text(reinterpret_cast<const char*>(start.data()), start.size());
    if (text.starts_with("\xEF\xBB\xBF"))
        text.remove_prefix(3);
    text.remove_prefix(std::min(text.find_first_not_of(" \t\r\n"), text.size()));
    return text.starts_with("bplist") || text.starts_with("<");
}

std::unique_ptr<RecordingReader> SnapshotRecording::open(std::span<const std::byte> content, std::string& why)
{
    const Value file = parsePropertyList(content, &why);
    if (!file)
        return nullptr;
    const Dictionary* snapshot = file.dictionary();
    const Value data = snapshot ? snapshot->at("Data") : Value(); // none in one without save contents
    if (!snapshot || !snapshot->find("Timestamp") || (data && !data.array())) {
        why = "a property list, but no snapshot";
        return nullptr;
    }
    auto recording = std::make_unique<SnapshotRecording>();
    for (std::size_t number = 0; data && number < data.array()->elements.size(); ++number) {
        const Dictionary* entry = data.array()->elements[number].dictionary();
        const Value messages = entry ? entry->at("DisplayState") : Value();
        if (!messages.data())
            continue;
        const Value date = entry->at("Date");
        recording->entries.push_back(
            {number, messages.sharedData(), timeOfDateText(date.string() ? *date.string() : std::string())});
    }
    return recording;
}

RecordingReader::Next SnapshotRecording::next(RecordedMessage& message)
{
    while (entry < entries.size() && offset == entries[entry].messages->size()) {
        ++entry;
        offset = 0;
    }
    if (entry == entries.size())
        return Next::end;
    const auto rest = std::span(*entries[entry].messages).subspan(offset);
    const auto length = messageLength(rest);
    if (!length) {
        reason = fmt::format("raw messages of entry {} make no sense from byte {} on", entries[entry].number,
                             offset);
        return Next::failed;
    }
    message = {entries[entry].time, rest.first(*length)};
    offset += *length;
    return Next::message;
}

RecordedTime timeOfDateText(const std::string& text)
{
    std::tm parts{};
    const char* rest = strptime(text.c_str(), "%Y-%m-%d %H:%M:%S %z", &parts);
    if (!rest)
        return {};
    const long zone = parts.tm_gmtoff; // timegm() sets it to 0
    return recordedTime(timegm(&parts) - zone);
}

} // namespace pelorus
