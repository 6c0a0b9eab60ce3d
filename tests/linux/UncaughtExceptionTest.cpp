#include "platform/linux/UncaughtException.h"

#include "platform/linux/CallbackBoundary.h"
#include "platform/linux/FileLogSink.h"

#include <cstdio>
#include <gtest/gtest.h>
#include <stdexcept>

namespace pelorus {

class SilentException {};

class SpeakingException : public std::exception {
public:
    const char* what() const noexcept override { return "index 7 of 3"; }
};

class NamedException : public std::exception {
public:
    const char* what() const noexcept override { return "NamedException"; }
};

class PlainException : public std::exception {};

struct Outer {
    class InnerException {};
};

namespace {

const auto kAborted = testing::KilledBySignal(SIGABRT);

/// Ends the process as a program with a log on standard error would end.
template <class Exception>
void endWith(Exception exception, std::function<void(const std::string&)> lastWords = nullptr)
{
    std::string why;
    const auto sink = FileLogSink::open("-", why);
    setSystemLogSink(sink.get());
    reportUncaughtException();
    setLastWords(std::move(lastWords));
    callAtBoundary([&] { throw exception; });
}

} // namespace

TEST(UncaughtException, IsNamedInTheSystemLog)
{
    EXPECT_EXIT(endWith(SilentException()), kAborted, "^<3>Uncaught exception: SilentException\n$");
    EXPECT_EXIT(endWith(Outer::InnerException()), kAborted,
                "^<3>Uncaught exception: Outer::InnerException\n$");
}

TEST(UncaughtException, SaysWhatItSaysWhenThatIsMoreThanItsName)
{
    EXPECT_EXIT(endWith(SpeakingException()), kAborted,
                "^<3>Uncaught exception: SpeakingException: index 7 of 3\n$");
    EXPECT_EXIT(endWith(std::out_of_range("far")), kAborted,
                "^<3>Uncaught exception: std::out_of_range: far\n$");
    EXPECT_EXIT(endWith(NamedException()), kAborted, "^<3>Uncaught exception: NamedException\n$");
    EXPECT_EXIT(endWith(PlainException()), kAborted, "^<3>Uncaught exception: PlainException\n$");
}

TEST(UncaughtException, TheLastWordsGetItsNameAfterTheLine)
{
    EXPECT_EXIT(
        endWith(SpeakingException(),
                [](const std::string& name) { std::fprintf(stderr, "Recovered after %s", name.c_str()); }),
        kAborted,
        "^<3>Uncaught exception: SpeakingException: index 7 of 3\nRecovered after SpeakingException$");
}

TEST(UncaughtException, TroubleInTheLastWordsDoesNotKeepTheProgramAlive)
{
    EXPECT_EXIT(endWith(SilentException(), [](const std::string&) { throw std::runtime_error("no disk"); }),
                kAborted,
                "^<3>Uncaught exception: SilentException\n<3>Uncaught exception while ending: no disk\n$");
    EXPECT_EXIT(endWith(SilentException(), [](const std::string&) { std::terminate(); }), kAborted,
                "^<3>Uncaught exception: SilentException\n$");
}

TEST(UncaughtException, TerminateWithoutOneIsSaidToo)
{
    const auto end = [] {
        std::string why;
        const auto sink = FileLogSink::open("-", why);
        setSystemLogSink(sink.get());
        reportUncaughtException();
        std::terminate();
    };
    EXPECT_EXIT(end(), kAborted, "^<3>Uncaught exception: terminate: no exception\n$");
}

TEST(UncaughtException, WhatWasPrintedIsNotLost)
{
    int ends[2];
    ASSERT_EQ(::pipe(ends), 0);
    const auto end = [&] {
        ::dup2(ends[1], STDOUT_FILENO);
        std::setvbuf(stdout, nullptr, _IOFBF, 4096);
        std::printf("a tree");
        endWith(SilentException());
    };
    EXPECT_EXIT(end(), kAborted, "");
    ::close(ends[1]);
    std::string printed(100, ' ');
    const auto count = ::read(ends[0], printed.data(), printed.size());
    ::close(ends[0]);
    ASSERT_GT(count, 0);
    printed.resize(static_cast<std::size_t>(count));
    EXPECT_EQ(printed, "a tree");
}

} // namespace pelorus
