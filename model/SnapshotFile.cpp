#include "model/SnapshotFile.h"

#include "platform/SystemLog.h"

#include <cerrno>
#include <cstring>
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

std::optional<std::string> writeSnapshotFile(Platform& platform, const Value& content, std::string* why)
{
    const auto seconds = std::chrono::floor<std::chrono::seconds>(platform.now()).time_since_epoch().count();
    const std::string path =
        fmt::format("{}/PelorusSnapshot-{}.pelorus", platform.snapshotDirectory(), seconds);
    errno = 0;
    if (platform.writePropertyList(content, path))
        return path;
    if (why)
        *why = fmt::format("{}: {}", path, errno ? std::strerror(errno) : "cannot be written");
    systemLog(kLogError, "Unable to write snapshot to %s", path);
    return std::nullopt;
}

} // namespace pelorus
