#include "platform/Platform.h"

#include <fmt/chrono.h>

namespace pelorus {

std::string dateText(std::chrono::system_clock::time_point moment)
{
    const auto seconds = std::chrono::floor<std::chrono::seconds>(moment);
    return fmt::format("{:%Y-%m-%d %H:%M:%S} +0000",
                       fmt::gmtime(std::chrono::system_clock::to_time_t(seconds)));
}

} // namespace pelorus
