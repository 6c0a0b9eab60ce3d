#include "platform/linux/SnapshotDirectory.h"

#include <cstdlib>
#include <filesystem>
#include <pwd.h>
#include <sys/stat.h>
#include <unistd.h>

namespace pelorus {

namespace fs = std::filesystem;

namespace {

fs::path homeDirectory()
{
    if (const char* home = std::getenv("HOME"); home && *home)
        return home;
    const passwd* user = ::getpwuid(::getuid());
    return user ? user->pw_dir : "/";
}

fs::path stateDirectory()
{
    // A relative path there is to be ignored (XDG base directories).
    if (const char* state = std::getenv("XDG_STATE_HOME"); state && *state == '/')
        return state;
    return homeDirectory() / ".local" / "state";
}

/// As the same document asks for: what is missing is made for the user alone.
void makePrivately(const fs::path& path)
{
    std::error_code error;
    if (fs::exists(path, error) || error)
        return;
    if (path.has_relative_path())
        makePrivately(path.parent_path());
    ::mkdir(path.c_str(), 0700);
}

} // namespace

std::string findSnapshotDirectory(const std::string& handset)
{
    std::error_code error;
    if (fs::is_directory(handset, error))
        return handset;
    const fs::path path = stateDirectory() / "pelorus" / "CrashReporter";
    makePrivately(path);
    return path.string();
}

} // namespace pelorus
