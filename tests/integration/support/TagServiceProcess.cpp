#include "support/TagServiceProcess.h"

#include <fcntl.h>
#include <signal.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <stdexcept>

#include "support/BrokerEnvironment.h"
#include "support/ScratchDirectory.h"

extern char** environ;

namespace Korvane::Veldra::Testing {
namespace {

constexpr auto kReadyTimeout = std::chrono::seconds(30);
constexpr auto kStopTimeout = std::chrono::seconds(30);
constexpr const char* kReadyLine = "kvveldra-tagservice ready";

// The environment of the child: ours with VELDRA_DATA_DIR replaced.
std::vector<std::string> ChildEnvironment(const std::string& dataRoot) {
    std::vector<std::string> result;
    for (char** entry = environ; *entry != nullptr; ++entry) {
        if (std::strncmp(*entry, "VELDRA_DATA_DIR=", 16) != 0) result.emplace_back(*entry);
    }
    result.push_back("VELDRA_DATA_DIR=" + dataRoot);
    return result;
}

std::vector<char*> Pointers(std::vector<std::string>& texts) {
    std::vector<char*> result;
    for (auto& text : texts) result.push_back(text.data());
    result.push_back(nullptr);
    return result;
}

// A JSON string of plain text: quotes, backslashes and control bytes escaped.
std::string JsonText(const std::string& text) {
    std::string out = "\"";
    for (const char c : text) {
        if (c == '"' || c == '\\') {
            out += '\\';
            out += c;
        } else if (static_cast<unsigned char>(c) < 0x20) {
            char escaped[8];
            std::snprintf(escaped, sizeof escaped, "\\u%04x", c);
            out += escaped;
        } else {
            out += c;
        }
    }
    return out + "\"";
}

}  // namespace

std::string WriteBrokerDataRoot(const BrokerSettings& broker, const std::string& directory,
                                const std::string& id, const std::string& exchange) {
    // Written by hand, as a deployment writes it, so that this support needs
    // nothing of the library and also serves tests of the shared library alone.
    const std::string text = "{\"Id\":" + JsonText(id) +
                             ",\"DisplayName\":\"private test broker\",\"ConnectionType\":\"Local\"" +
                             ",\"ExchangeName\":" + JsonText(exchange) + ",\"Host\":" +
                             JsonText(broker.Host) + ",\"VirtualHost\":" +
                             JsonText(broker.VirtualHost) +
                             ",\"Port\":" + std::to_string(broker.AmqpPort) +
                             ",\"User\":" + JsonText(broker.User) +
                             ",\"Password\":" + JsonText(broker.Password) + ",\"UseTls\":false}";
    const std::filesystem::path folder = std::filesystem::path(directory) / "VeldraConfigurations";
    std::filesystem::create_directories(folder);
    std::ofstream file(folder / (id + ".json"), std::ios::trunc);
    file << text;
    if (!file.flush()) throw std::runtime_error("cannot write " + (folder / id).string() + ".json");
    return directory;
}

const std::string& UseBrokerDataRoot() {
    // Made on first use, removed when the process ends.
    struct DataRoot {
        DataRoot() {
            WriteBrokerDataRoot(Broker(), directory.Path());
            setenv("VELDRA_DATA_DIR", directory.Path().c_str(), 1);
        }
        ScratchDirectory directory{"kvveldra-data"};
    };
    static const DataRoot root;
    return root.directory.Path();
}

TagServiceProcess::TagServiceProcess(Options options) {
    const std::string dataRoot = options.dataRoot.empty() ? UseBrokerDataRoot() : options.dataRoot;
    std::vector<std::string> args{KVVELDRA_TAGSERVICE_PATH};
    if (!options.store.empty()) args.insert(args.end(), {"--store", options.store});
    if (options.verbose) args.push_back("--verbose");
    args.insert(args.end(), options.extraArgs.begin(), options.extraArgs.end());
    std::vector<std::string> environment = ChildEnvironment(dataRoot);
    std::vector<char*> argv = Pointers(args);
    std::vector<char*> envp = Pointers(environment);

    int pipeFds[2];
    if (pipe2(pipeFds, O_CLOEXEC) != 0) {
        throw std::runtime_error(std::string("pipe: ") + std::strerror(errno));
    }
    pid_ = fork();
    if (pid_ == 0) {
        // Only async-signal-safe calls from here on.
        sigset_t none;
        sigemptyset(&none);
        sigprocmask(SIG_SETMASK, &none, nullptr);
        const int devNull = open("/dev/null", O_RDONLY);
        dup2(devNull, STDIN_FILENO);
        dup2(pipeFds[1], STDOUT_FILENO);
        dup2(pipeFds[1], STDERR_FILENO);
        // Nothing else of this process, its broker connections least of all.
        if (syscall(SYS_close_range, 3U, ~0U, 0U) != 0) {
            for (int fd = 3; fd < 65536; ++fd) close(fd);
        }
        execve(argv[0], argv.data(), envp.data());
        _exit(127);
    }
    close(pipeFds[1]);
    if (pid_ < 0) {
        close(pipeFds[0]);
        throw std::runtime_error(std::string("fork: ") + std::strerror(errno));
    }
    reader_ = std::thread([this, fd = pipeFds[0]] { ReadOutput(fd); });
    const std::string readyLine = options.readyLine.empty() ? kReadyLine : options.readyLine;
    if (!WaitForOutput(readyLine, kReadyTimeout)) {
        Kill();
        reader_.join();  // the output ends with the child
        throw std::runtime_error("kvveldra-tagservice did not print its ready line; its output:\n" +
                                 Output());
    }
}

TagServiceProcess::~TagServiceProcess() {
    Stop();
    if (reader_.joinable()) reader_.join();
}

void TagServiceProcess::ReadOutput(int fd) {
    char buffer[4096];
    for (;;) {
        const ssize_t got = read(fd, buffer, sizeof buffer);
        if (got < 0 && errno == EINTR) continue;
        if (got <= 0) break;
        std::lock_guard<std::mutex> lock(mutex_);
        output_.append(buffer, static_cast<std::size_t>(got));
        changed_.notify_all();
    }
    close(fd);
    std::lock_guard<std::mutex> lock(mutex_);
    ended_ = true;
    changed_.notify_all();
}

bool TagServiceProcess::WaitForOutput(const std::string& text,
                                      std::chrono::milliseconds timeout) const {
    std::unique_lock<std::mutex> lock(mutex_);
    return changed_.wait_for(lock, timeout, [&] {
        return output_.find(text) != std::string::npos || ended_;
    }) && output_.find(text) != std::string::npos;
}

bool TagServiceProcess::WaitForEnd(std::chrono::milliseconds timeout) const {
    std::unique_lock<std::mutex> lock(mutex_);
    return changed_.wait_for(lock, timeout, [&] { return ended_; });
}

std::string TagServiceProcess::Output() const {
    std::lock_guard<std::mutex> lock(mutex_);
    return output_;
}

int TagServiceProcess::Reap() {
    if (reaped_) return status_;
    int status = 0;
    while (waitpid(pid_, &status, 0) < 0 && errno == EINTR) {
    }
    reaped_ = true;
    status_ = WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
    return status_;
}

int TagServiceProcess::Stop() {
    if (pid_ <= 0 || reaped_) return status_;
    kill(pid_, SIGTERM);
    if (!WaitForEnd(kStopTimeout)) kill(pid_, SIGKILL);
    return Reap();
}

void TagServiceProcess::Kill() {
    if (pid_ <= 0 || reaped_) return;
    kill(pid_, SIGKILL);
    Reap();
}

}  // namespace Korvane::Veldra::Testing
