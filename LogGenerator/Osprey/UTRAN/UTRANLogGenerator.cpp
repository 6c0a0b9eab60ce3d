#include "LogGenerator/Osprey/UTRAN/UTRANLogGenerator.h"

#include "LogGenerator/Osprey/UTRAN/UTRANClassIndex.h"
#include "platform/SystemLog.h"

#include <algorithm>
#include <cctype>
#include <filesystem>

namespace pelorus {

namespace {

bool namesUTRAN(const std::string& path)
{
    constexpr std::string_view kName = "UTRAN";
    return std::search(path.begin(), path.end(), kName.begin(), kName.end(), [](char a, char b) {
               return std::toupper(static_cast<unsigned char>(a)) == b;
           }) != path.end();
}

} // namespace

std::unique_ptr<UTRANLogGenerator> UTRANLogGenerator::generator(Platform& platform)
{
    return std::make_unique<UTRANLogGenerator>(platform);
}

UTRANLogGenerator::UTRANLogGenerator(Platform& system) : OSPLogGenerator2(system)
{
    const std::vector<std::string> resources = system.listPropertyListResources();
    const auto found = std::find_if(resources.begin(), resources.end(), namesUTRAN);
    if (found == resources.end())
        return;
    initWithPListName(std::filesystem::path(*found).stem().string(), std::make_shared<UTRANClassIndex>());
    systemLog(kLogError, "Created UTRANLogGenerator object");
}

} // namespace pelorus
