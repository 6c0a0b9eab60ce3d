#include "model/SnapshotFile.h"

#include "platform/SystemLog.h"

#include <fmt/format.h>

namespace pelorus {

Value snapshotFileContent(const std::string& timestamp, const std::shared_ptr<Array>& saveContents,
                          const std::string& description)
{
    auto content = makeDictionary({{"Timestamp", timestamp}});
    if (saveContents) {
        content->set(Label("Data"), saveContents);
        content->set(Label("Description"), description);
    }
    return content;
}

std::optional<std::string> writeSnapshotFile(Platform& platform, const Value& content)
{
    const auto seconds = std::chrono::floor<std::chrono::seconds>(platform.now()).time_since_epoch().count();
    const std::string path =
        fmt::format("{}/PelorusSnapshot-{}.pelorus", platform.snapshotDirectory(), seconds);
    if (platform.writePropertyList(content, path))
        return path;
    systemLog(kLogError, "Unable to write snapshot to %s", path);
    return std::nullopt;
}

} // namespace pelorus
