#include "OutputChannel.h"

#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <iostream>

namespace kvtag {

OutputChannel::OutputChannel() {
    std::fflush(stdout);
    std::cout.flush();
    realStdout_ = dup(STDOUT_FILENO);
    if (realStdout_ >= 0) dup2(STDERR_FILENO, STDOUT_FILENO);
}

OutputChannel::~OutputChannel() {
    std::fflush(stdout);
    std::cout.flush();
    if (realStdout_ >= 0) {
        dup2(realStdout_, STDOUT_FILENO);
        close(realStdout_);
    }
}

bool OutputChannel::Write(const std::string& text) {
    const int fd = realStdout_ >= 0 ? realStdout_ : STDOUT_FILENO;
    std::size_t done = 0;
    while (done < text.size()) {
        const ssize_t count = ::write(fd, text.data() + done, text.size() - done);
        if (count < 0 && errno == EINTR) continue;
        if (count <= 0) return false;
        done += static_cast<std::size_t>(count);
    }
    return true;
}

}  // namespace kvtag
