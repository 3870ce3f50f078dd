#include "support/CommandRunner.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <cstring>

extern char** environ;

namespace Korvane::Veldra::Testing {
namespace {

constexpr int kKillAfterSeconds = 5;

// Closes a descriptor when it goes out of scope.
class Descriptor {
public:
    explicit Descriptor(int fd = -1) : fd_(fd) {}
    ~Descriptor() { Reset(); }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    int Get() const { return fd_; }
    void Reset() {
        if (fd_ >= 0) {
            close(fd_);
            fd_ = -1;
        }
    }

private:
    int fd_;
};

// Spawns the program under coreutils' timeout with its output into writeEnd.
pid_t Spawn(const std::vector<std::string>& argv, int timeoutSeconds, int writeEnd,
            std::string& error) {
    std::vector<std::string> words = {"timeout",
                                      "--kill-after=" + std::to_string(kKillAfterSeconds),
                                      std::to_string(timeoutSeconds)};
    words.insert(words.end(), argv.begin(), argv.end());
    std::vector<char*> args;
    for (auto& word : words) {
        args.push_back(word.data());
    }
    args.push_back(nullptr);

    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
    posix_spawn_file_actions_adddup2(&actions, writeEnd, STDOUT_FILENO);
    posix_spawn_file_actions_adddup2(&actions, writeEnd, STDERR_FILENO);
    pid_t pid = -1;
    const int status = posix_spawnp(&pid, "timeout", &actions, nullptr, args.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    if (status != 0) {
        error = std::string("cannot start timeout: ") + std::strerror(status);
        return -1;
    }
    return pid;
}

// Reads until end of file or the deadline; false if the deadline came first.
bool ReadAll(int fd, std::chrono::steady_clock::time_point deadline, std::string& out) {
    char buffer[4096];
    for (;;) {
        const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
            deadline - std::chrono::steady_clock::now());
        if (left.count() <= 0) {
            return false;
        }
        pollfd entry{fd, POLLIN, 0};
        const int ready = poll(&entry, 1, static_cast<int>(left.count()));
        if (ready < 0 && errno == EINTR) {
            continue;
        }
        if (ready == 0) {
            return false;
        }
        if (ready < 0) {
            return true;  // nothing more can be read
        }
        const ssize_t count = read(fd, buffer, sizeof buffer);
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count <= 0) {
            return true;
        }
        out.append(buffer, static_cast<size_t>(count));
    }
}

int WaitForExit(pid_t pid) {
    int status = 0;
    while (waitpid(pid, &status, 0) < 0) {
        if (errno != EINTR) {
            return -1;
        }
    }
    if (WIFEXITED(status)) {
        return WEXITSTATUS(status);
    }
    return WIFSIGNALED(status) ? 128 + WTERMSIG(status) : -1;
}

}  // namespace

CommandResult RunCommand(const std::vector<std::string>& argv, int timeoutSeconds) {
    CommandResult result;
    if (argv.empty() || timeoutSeconds <= 0) {
        result.Output = "RunCommand: no program or no time to run it";
        return result;
    }
    int ends[2];
    if (pipe2(ends, O_CLOEXEC) != 0) {
        result.Output = std::string("pipe2: ") + std::strerror(errno);
        return result;
    }
    Descriptor readEnd(ends[0]);
    Descriptor writeEnd(ends[1]);
    const pid_t pid = Spawn(argv, timeoutSeconds, writeEnd.Get(), result.Output);
    writeEnd.Reset();
    if (pid < 0) {
        return result;
    }
    // Anything the program left running may hold the pipe open after it ends;
    // the deadline covers that as well as the time-out itself.
    const auto deadline = std::chrono::steady_clock::now() +
                          std::chrono::seconds(timeoutSeconds + kKillAfterSeconds + 5);
    if (!ReadAll(readEnd.Get(), deadline, result.Output)) {
        kill(pid, SIGKILL);
        result.Output += "\n(output still open after the time-out)";
    }
    result.ExitCode = WaitForExit(pid);
    if (result.ExitCode == 124) {
        result.Output += "\n(timed out after " + std::to_string(timeoutSeconds) + " s)";
    }
    return result;
}

}  // namespace Korvane::Veldra::Testing
