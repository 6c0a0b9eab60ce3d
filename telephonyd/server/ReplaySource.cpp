#include "telephonyd/server/ReplaySource.h"

#include <fmt/format.h>

namespace pelorus {

SourceFactory ReplaySource::factory(std::string path, Report report)
{
    return [path = std::move(path),
            report = std::move(report)](std::string& why) -> std::unique_ptr<MessageSource> {
        auto reader = RecordingReader::open(path, why);
        if (!reader) {
            why = fmt::format("{}: {}", path, why);
            return nullptr;
        }
        return std::make_unique<ReplaySource>(path, std::move(reader), report);
    };
}

ReplaySource::ReplaySource(std::string path, std::unique_ptr<RecordingReader> opened, Report report)
    : path(std::move(path)), reader(std::move(opened)), report(std::move(report))
{}

bool ReplaySource::next(SourceMessage& message)
{
    RecordedMessage recorded;
    switch (reader->next(recorded)) {
    case RecordingReader::Next::message:
        message = {recorded.time.time_since_epoch(), recorded.bytes};
        return true;
    case RecordingReader::Next::failed:
        if (!brokenReported) // once, not in every round of a loop
            report(fmt::format("{}: {}", path, reader->why()));
        brokenReported = true;
        return false;
    case RecordingReader::Next::end:
        break;
    }
    return false;
}

bool ReplaySource::rewind()
{
    std::string why;
    auto again = RecordingReader::open(path, why);
    if (!again) {
        report(fmt::format("{}: {}", path, why));
        return false;
    }
    reader = std::move(again);
    return true;
}

} // namespace pelorus
