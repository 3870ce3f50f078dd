#include "kvtag/KvtagProcess.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <map>

extern char** environ;

namespace Korvane::Veldra::Testing {
namespace {

// One pipe; both ends closed when it goes.
struct Pipe {
    int ends[2] = {-1, -1};
    Pipe() {
        if (pipe2(ends, O_CLOEXEC) != 0) ends[0] = ends[1] = -1;
    }
    ~Pipe() {
        CloseRead();
        CloseWrite();
    }
    Pipe(const Pipe&) = delete;
    Pipe& operator=(const Pipe&) = delete;
    void CloseRead() {
        if (ends[0] >= 0) close(ends[0]);
        ends[0] = -1;
    }
    void CloseWrite() {
        if (ends[1] >= 0) close(ends[1]);
        ends[1] = -1;
    }
    bool Ok() const { return ends[0] >= 0; }
};

std::vector<std::string> Environment(
    const std::vector<std::pair<std::string, std::string>>& overrides) {
    std::map<std::string, std::string> variables;
    for (char** entry = environ; *entry; ++entry) {
        const std::string text = *entry;
        const auto equals = text.find('=');
        if (equals != std::string::npos)
            variables[text.substr(0, equals)] = text.substr(equals + 1);
    }
    for (const auto& [name, value] : overrides) variables[name] = value;
    std::vector<std::string> result;
    for (const auto& [name, value] : variables) result.push_back(name + "=" + value);
    return result;
}

}  // namespace

KvtagRun RunKvtag(const std::vector<std::string>& args, const std::string& input,
                  const std::vector<std::pair<std::string, std::string>>& environment,
                  int timeoutSeconds) {
    KvtagRun run;
    // A child that ends before reading all its input must not end the test.
    signal(SIGPIPE, SIG_IGN);
    Pipe in, out, err;
    if (!in.Ok() || !out.Ok() || !err.Ok()) {
        run.err = "pipe2 failed";
        return run;
    }
    std::vector<std::string> words = {"timeout", "--kill-after=5", std::to_string(timeoutSeconds),
                                      KVTAG_PATH};
    words.insert(words.end(), args.begin(), args.end());
    std::vector<char*> argv;
    for (auto& word : words) argv.push_back(word.data());
    argv.push_back(nullptr);
    auto variables = Environment(environment);
    std::vector<char*> envp;
    for (auto& variable : variables) envp.push_back(variable.data());
    envp.push_back(nullptr);

    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, in.ends[0], STDIN_FILENO);
    posix_spawn_file_actions_adddup2(&actions, out.ends[1], STDOUT_FILENO);
    posix_spawn_file_actions_adddup2(&actions, err.ends[1], STDERR_FILENO);
    const auto start = std::chrono::steady_clock::now();
    pid_t pid = -1;
    const int status = posix_spawnp(&pid, "timeout", &actions, nullptr, argv.data(), envp.data());
    posix_spawn_file_actions_destroy(&actions);
    in.CloseRead();
    out.CloseWrite();
    err.CloseWrite();
    if (status != 0) {
        run.err = std::string("cannot start kvtag: ") + std::strerror(status);
        return run;
    }

    // Feed the input and collect both outputs together, so that no pipe
    // fills up while another is waited on.
    std::size_t written = 0;
    if (input.empty())
        in.CloseWrite();
    else
        fcntl(in.ends[1], F_SETFL, O_NONBLOCK);
    bool outOpen = true, errOpen = true;
    char buffer[4096];
    while (outOpen || errOpen) {
        pollfd entries[3] = {{out.ends[0], static_cast<short>(outOpen ? POLLIN : 0), 0},
                             {err.ends[0], static_cast<short>(errOpen ? POLLIN : 0), 0},
                             {in.ends[1], static_cast<short>(in.ends[1] >= 0 ? POLLOUT : 0), 0}};
        if (poll(entries, 3, -1) < 0) {
            if (errno == EINTR) continue;
            break;
        }
        if (in.ends[1] >= 0 && (entries[2].revents & (POLLOUT | POLLERR | POLLHUP))) {
            const ssize_t count = write(in.ends[1], input.data() + written, input.size() - written);
            if (count > 0) written += static_cast<std::size_t>(count);
            if (count < 0 && errno != EAGAIN && errno != EINTR) written = input.size();
            if (written >= input.size()) in.CloseWrite();
        }
        for (int i = 0; i < 2; ++i) {
            if (!(entries[i].revents & (POLLIN | POLLHUP | POLLERR))) continue;
            const ssize_t count = read(entries[i].fd, buffer, sizeof buffer);
            if (count < 0 && errno == EINTR) continue;
            std::string& target = i == 0 ? run.out : run.err;
            if (count > 0) {
                target.append(buffer, static_cast<std::size_t>(count));
            } else {
                (i == 0 ? outOpen : errOpen) = false;
            }
        }
    }
    in.CloseWrite();
    int waitStatus = 0;
    while (waitpid(pid, &waitStatus, 0) < 0 && errno == EINTR) {
    }
    run.elapsed = std::chrono::duration_cast<std::chrono::milliseconds>(
        std::chrono::steady_clock::now() - start);
    run.exitCode = WIFEXITED(waitStatus)
                       ? WEXITSTATUS(waitStatus)
                       : 128 + (WIFSIGNALED(waitStatus) ? WTERMSIG(waitStatus) : 0);
    return run;
}

}  // namespace Korvane::Veldra::Testing
