#include "platform/linux/ResourceDirectory.h"

#include <algorithm>
#include <filesystem>

namespace pelorus {

namespace fs = std::filesystem;

ResourceDirectory ResourceDirectory::beside(const std::string& executable)
{
    const fs::path above = fs::path(executable).parent_path().parent_path();
    if (ResourceDirectory ofBuildTree((above / "resources").string()); !ofBuildTree.list().empty())
        return ofBuildTree;
    return ResourceDirectory((above / "share" / "pelorus").string());
}

ResourceDirectory ResourceDirectory::besideThisProgram()
{
    std::error_code error;
    return beside(fs::read_symlink("/proc/self/exe", error).string());
}

std::optional<std::string> ResourceDirectory::find(const std::string& name) const
{
    if (name.empty() || name.find('/') != std::string::npos || name.find('\0') != std::string::npos)
        return std::nullopt;
    const std::string path = directory + '/' + name + ".plist";
    std::error_code error;
    return fs::is_regular_file(path, error) ? std::optional(path) : std::nullopt;
}

std::vector<std::string> ResourceDirectory::list() const
{
    std::vector<std::string> paths;
    std::error_code error;
    for (fs::directory_iterator entry(directory, error), end; !error && entry != end;
         entry.increment(error)) {
        std::error_code unreadable;
        if (entry->path().extension() == ".plist" && entry->is_regular_file(unreadable))
            paths.push_back(directory + '/' + entry->path().filename().string());
    }
    std::ranges::sort(paths);
    return paths;
}

} // namespace pelorus
