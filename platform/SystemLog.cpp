#include "platform/SystemLog.h"

#include <utility>

namespace pelorus {

namespace detail {

SystemLogSink* systemLogSink = nullptr;

void writeSystemLog(int priority, std::string_view format, fmt::printf_args args)
{
    systemLogSink->write(priority, fmt::vsprintf(fmt::string_view(format.data(), format.size()), args));
}

} // namespace detail

SystemLogSink* setSystemLogSink(SystemLogSink* sink)
{
    return std::exchange(detail::systemLogSink, sink);
}

} // namespace pelorus
