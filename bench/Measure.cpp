// Runs a command to its end with its output thrown away, and prints what it took as one JSON object: seconds
// on the clock, seconds of processor time, the peak of its resident memory in KiB, its exit status. A small
// program, because a process inherits the peak of the one that starts it.

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstring>
#include <ctime>
#include <fcntl.h>
#include <sys/prctl.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

double now()
{
    timespec time{};
    clock_gettime(CLOCK_MONOTONIC, &time);
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * 1e-9;
}

double seconds(const timeval& time)
{
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_usec) * 1e-6;
}

void become(char** command)
{
    prctl(PR_SET_PDEATHSIG, SIGKILL); // nothing goes on when the measurement is broken off
    const int nowhere = open("/dev/null", O_WRONLY);
    dup2(nowhere, STDOUT_FILENO);
    dup2(nowhere, STDERR_FILENO);
    execvp(command[0], command);
    _exit(127);
}

} // namespace

int main(int argc, char** argv)
{
    if (argc < 2) {
        std::fprintf(stderr, "usage: bench_Measure COMMAND [ARGUMENT...]\n");
        return 2;
    }
    const double begin = now();
    const pid_t child = fork();
    if (child == 0)
        become(argv + 1);
    int status = 0;
    rusage used{};
    if (child < 0 || wait4(child, &status, 0, &used) != child) {
        std::fprintf(stderr, "bench_Measure: %s\n", std::strerror(errno));
        return 1;
    }
    std::printf("{\"wall\": %.6f, \"processor\": %.6f, \"peak\": %ld, \"status\": %d}\n", now() - begin,
                seconds(used.ru_utime) + seconds(used.ru_stime), used.ru_maxrss,
                WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status));
    return 0;
}
