#include "platform/Console.h"

#include <utility>

namespace pelorus {

namespace {

std::function<void(std::string_view)>& console()
{
    static std::function<void(std::string_view)> chosen;
    return chosen;
}

} // namespace

void setConsole(std::function<void(std::string_view line)> chosen)
{
    console() = std::move(chosen);
}

bool consoleListens()
{
    return static_cast<bool>(console());
}

void consoleLine(std::string_view line)
{
    if (console())
        console()(line);
}

} // namespace pelorus
