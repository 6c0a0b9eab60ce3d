#include "pelorusctl/Output.h"

#include "platform/PrintableText.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <fmt/format.h>

namespace pelorus {

namespace {

int outputError = 0;

} // namespace

bool print(std::string_view text)
{
    if (std::fwrite(text.data(), 1, text.size(), stdout) == text.size() && std::fflush(stdout) == 0)
        return true;
    outputError = errno;
    return false;
}

int finishOutput(int status)
{
    return outputError ? fail("standard output", std::strerror(outputError)) : status;
}

int fail(std::string_view name, std::string_view why)
{
    fmt::print(stderr, "pelorusctl: {}: {}\n", printable(name), printable(why)); // one line whatever the name
    return kUnreadable;
}

bool isDirectory(const std::string& path)
{
    std::error_code none;
    return std::filesystem::is_directory(path, none);
}

bool isSameFile(const std::string& one, const std::string& other)
{
    std::error_code none;
    return std::filesystem::equivalent(one, other, none);
}

} // namespace pelorus
