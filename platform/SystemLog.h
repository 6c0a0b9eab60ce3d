#pragma once

#include <fmt/printf.h>
#include <string_view>

namespace pelorus {

/// Numeric priorities of the system log.
enum LogPriority : int { kLogError = 3, kLogWarning = 4, kLogNotice = 5 };

/// Takes every line that the program sends to the system log. `priority` is numeric (3 error, 4 warning, 5
/// notice, ...), `text` as formatted, line feeds included.
class SystemLogSink {
public:
    virtual ~SystemLogSink() = default;
    virtual void write(int priority, std::string_view text) = 0;
};

/// Chosen by the program's entry; nullptr (the default) drops every line before it is formatted. Returns the
/// sink that was set before. Not owned.
SystemLogSink* setSystemLogSink(SystemLogSink* sink);

namespace detail {
extern SystemLogSink* systemLogSink;
void writeSystemLog(int priority, std::string_view format, fmt::printf_args args);
} // namespace detail

inline bool systemLogListens()
{
    return detail::systemLogSink != nullptr;
}

/// Writes one line; `format` is a printf text ("%d", "%s", "%p", "%ld", "%lf").
template <class... Args> void systemLog(int priority, std::string_view format, const Args&... args)
{
    if (systemLogListens()) [[unlikely]]
        detail::writeSystemLog(priority, format, fmt::make_format_args<fmt::printf_context>(args...));
}

} // namespace pelorus
