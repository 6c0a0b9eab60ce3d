#include "app/content/InternalBuildMarker.h"

namespace pelorus {

bool isInternalBuild(Platform& platform, const std::string& dataDirectory)
{
    const std::string marker = "/BrindleInternal/Library/PreferenceBundles/Carrier Settings.bundle";
    return platform.fileExists(marker) || platform.fileExists(dataDirectory + marker);
}

} // namespace pelorus
