#include "platform/linux/UncaughtException.h"

#include "platform/SystemLog.h"

#include <atomic>
#include <cstdio>
#include <cstdlib>
#include <cxxabi.h>
#include <exception>
#include <memory>

namespace pelorus {

namespace {

std::function<void(const std::string&)> chosenLastWords;

struct Description {
    std::string name;
    std::string saying; // empty unless it says more than the name
};

std::string nameOf(const std::type_info& type)
{
    int status = 0;
    const std::unique_ptr<char, decltype(&std::free)> text(
        abi::__cxa_demangle(type.name(), nullptr, nullptr, &status), &std::free);
    const std::string_view name = text ? text.get() : type.name();
    constexpr std::string_view own = "pelorus::";
    return std::string(name.starts_with(own) ? name.substr(own.size()) : name);
}

Description describeCurrentException()
{
    const std::type_info* type = abi::__cxa_current_exception_type();
    if (!type)
        return {"terminate", "no exception"};
    Description description{nameOf(*type), {}};
    try {
        throw;
    } catch (const std::exception& exception) {
        const std::string saying = exception.what();
        if (saying != "std::exception" && saying != type->name() && nameOf(*type) != saying)
            description.saying = saying;
    } catch (...) {
        // Any other type says nothing but its name.
    }
    return description;
}

[[noreturn]] void endProgram() noexcept
{
    static std::atomic_flag entered;
    if (!entered.test_and_set()) {
        const auto [name, saying] = describeCurrentException();
        if (saying.empty())
            systemLog(kLogError, "Uncaught exception: %s", name);
        else
            systemLog(kLogError, "Uncaught exception: %s: %s", name, saying);
        std::fflush(stdout);
        try {
            if (chosenLastWords)
                chosenLastWords(name);
        } catch (const std::exception& exception) {
            systemLog(kLogError, "Uncaught exception while ending: %s", std::string(exception.what()));
        } catch (...) {
            systemLog(kLogError, "Uncaught exception while ending");
        }
    }
    std::abort();
}

} // namespace

void reportUncaughtException()
{
    std::set_terminate(endProgram);
}

void setLastWords(std::function<void(const std::string& name)> lastWords)
{
    chosenLastWords = std::move(lastWords);
}

} // namespace pelorus
