#include "platform/linux/PassedSockets.h"

#include "tests/linux/PortFixture.h"

#include <fcntl.h>
#include <sys/wait.h>

namespace pelorus {

using namespace test;

namespace {

/// In a process of its own, whose descriptors from 3 on are these tests' to choose: the number of sockets it
/// takes, the second time too, when `announced` are announced and two are there.
int takenBy(const char* announced, bool toMe)
{
    const pid_t child = ::fork();
    if (child == 0) {
        const int null = ::open("/dev/null", O_RDWR);
        ::dup2(null, 3);
        ::dup2(null, 4);
        ::close(5);
        const EnvironmentVariable process("LISTEN_PID", std::to_string(::getpid() + (toMe ? 0 : 1)).c_str());
        const EnvironmentVariable count("LISTEN_FDS", announced);
        auto sockets = takePassedSockets();
        int result = static_cast<int>(sockets.size());
        for (const FileDescriptor& socket : sockets)
            if ((::fcntl(socket.get(), F_GETFD) & FD_CLOEXEC) == 0)
                result += 100;
        if (!takePassedSockets().empty() || std::getenv("LISTEN_FDS"))
            result += 50;
        ::_exit(result);
    }
    int status = 0;
    ::waitpid(child, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

} // namespace

TEST(PassedSockets, AreTakenOnceAndNotHandedOn)
{
    EXPECT_EQ(takenBy("1", true), 1);
    EXPECT_EQ(takenBy("2", true), 2);
}

TEST(PassedSockets, OfAnotherProcessAreNotTaken)
{
    EXPECT_EQ(takenBy("2", false), 0);
}

TEST(PassedSockets, AreNoneWhenTheNumberIsNone)
{
    EXPECT_EQ(takenBy(nullptr, true), 0);
    EXPECT_EQ(takenBy("", true), 0);
    EXPECT_EQ(takenBy("-1", true), 0);
    EXPECT_EQ(takenBy("two", true), 0);
    EXPECT_EQ(takenBy("1000000", true), 0);
}

TEST(PassedSockets, ThatAreNotThereAreLeftOut)
{
    EXPECT_EQ(takenBy("3", true), 2);
}

} // namespace pelorus
