/// \file
/// Runs a command and prints its wall time in seconds, its peak memory in bytes and how it ended
/// (its exit status, or minus the signal's number). The kernel counts the memory of the process
/// that forked into the child's peak, so the fork is made here, where next to none is held, and
/// not in the interpreter that asks for it.
#include <chrono>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

volatile pid_t child = 0;

/// The child's part: the command, silent and without input.
[[noreturn]] void Become(char** command) {
    const int nothing = open("/dev/null", O_RDWR);
    for (const int stream : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
        dup2(nothing, stream);
    }
    execvp(command[0], command);
    _exit(127);
}

int WaitFor(pid_t process, rusage& usage) {
    int status = 0;
    while (wait4(process, &status, 0, &usage) < 0) {
        // Interrupted by the alarm, which has just killed it.
    }
    return WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
}

} // namespace

int main(int argc, char** argv) {
    if (argc < 3) {
        std::fputs("usage: orn_bench_measure LIMIT-IN-SECONDS COMMAND...\n", stderr);
        return 2;
    }
    const auto start = std::chrono::steady_clock::now();
    child = fork();
    if (child < 0) {
        std::perror("orn_bench_measure");
        return 1;
    }
    if (child == 0) {
        Become(argv + 2);
    }
    std::signal(SIGALRM, [](int) { kill(child, SIGKILL); });
    alarm(static_cast<unsigned>(std::strtoul(argv[1], nullptr, 10)));
    rusage usage{};
    const int status = WaitFor(child, usage);
    alarm(0);
    const std::chrono::duration<double> wall = std::chrono::steady_clock::now() - start;
    std::printf("%.6f %lld %d\n", wall.count(), static_cast<long long>(usage.ru_maxrss) * 1024,
                status);
    return 0;
}
