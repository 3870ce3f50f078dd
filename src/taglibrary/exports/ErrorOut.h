#pragma once

#include <cstdint>
#include <string>

#include "kvveldra/WBTypes.h"

namespace Korvane::Veldra::TagLibrary {

// The error out-parameter of the console family: a standard string that a
// failing call assigns. A null pointer just drops the text.
class ConsoleErrorOut {
public:
    explicit ConsoleErrorOut(std::string* target) : target_(target) {}
    int32_t Report(int32_t status, const std::string& text) {
        if (target_ != nullptr) *target_ = text;
        return status;
    }

private:
    std::string* target_;
};

// The error out-parameter of the host family: a host string handle that a
// failing call resizes and fills. When the text cannot be stored, the status
// of that failure replaces the call's own.
class HostErrorOut {
public:
    explicit HostErrorOut(WBStrHandle* target) : target_(target) {}
    int32_t Report(int32_t status, const std::string& text);

private:
    WBStrHandle* target_;
};

}  // namespace Korvane::Veldra::TagLibrary
