#pragma once

#include <stdlib.h>

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <stdexcept>
#include <string>
#include <system_error>

namespace Korvane::Veldra::Testing {

// A fresh directory under $TMPDIR (else /tmp), removed with everything in it
// when the object goes.
class ScratchDirectory {
public:
    explicit ScratchDirectory(const std::string& stem = "kvveldra") {
        const char* tmp = getenv("TMPDIR");
        path_ = std::string(tmp != nullptr && *tmp != '\0' ? tmp : "/tmp") + "/" + stem + ".XXXXXX";
        if (mkdtemp(path_.data()) == nullptr) {
            throw std::runtime_error("mkdtemp " + path_ + ": " + std::strerror(errno));
        }
    }
    ~ScratchDirectory() {
        std::error_code ignored;
        std::filesystem::remove_all(path_, ignored);
    }
    ScratchDirectory(const ScratchDirectory&) = delete;
    ScratchDirectory& operator=(const ScratchDirectory&) = delete;

    const std::string& Path() const { return path_; }

private:
    std::string path_;
};

}  // namespace Korvane::Veldra::Testing
