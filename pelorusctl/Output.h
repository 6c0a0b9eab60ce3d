#pragma once

#include <string>
#include <string_view>

namespace pelorus {

/// Exit statuses of the program.
enum ExitStatus : int { kSuccess = 0, kUnreadable = 1, kWrongUsage = 2 };

/// Writes to standard output at once. False when it does not take everything, which finishOutput() reports.
bool print(std::string_view text);
/// `status`, or 1 and a line on standard error when standard output did not take everything.
int finishOutput(int status);

/// "pelorusctl: NAME: what is wrong with it" on standard error; returns exit status 1.
int fail(std::string_view name, std::string_view why);

bool isDirectory(const std::string& path);
/// Whether both exist and are one.
bool isSameFile(const std::string& one, const std::string& other);

} // namespace pelorus
