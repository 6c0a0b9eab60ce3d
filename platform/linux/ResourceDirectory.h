#pragma once

#include <optional>
#include <string>
#include <vector>

namespace pelorus {

/// The property-list resources of a directory.
class ResourceDirectory {
public:
    explicit ResourceDirectory(std::string path) : directory(std::move(path)) {}
    /// Those beside a program: `resources` of a build tree, else `share/pelorus` of an installation.
    static ResourceDirectory beside(const std::string& executable);
    /// Those beside the running program.
    static ResourceDirectory besideThisProgram();

    const std::string& path() const { return directory; }
    std::optional<std::string> find(const std::string& name) const;
    /// In ascending order.
    std::vector<std::string> list() const;

private:
    std::string directory;
};

} // namespace pelorus
