#include "support/ConsoleInstance.h"

#include "kvveldra/TagConsole.h"

namespace Korvane::Veldra::Bench {

ConsoleInstance::ConsoleInstance(uint64_t id, const std::string& configuration) : id_(id) {
    std::string text;
    if (TagConsoleReserve(&reserved_) != 0) {
        error_ = "console set-up failed: the reservation was refused";
    } else if (TagConsoleInitialize(id, configuration.empty() ? nullptr : &configuration, nullptr,
                                    nullptr, &text) != 0) {
        error_ = "console set-up failed: " + text;
    }
}

ConsoleInstance::~ConsoleInstance() {
    std::string ignored;
    TagConsoleCloseInstance(id_, &ignored);  // 1 for the default instance, which stays
    TagConsoleUnreserve(&reserved_);
}

}  // namespace Korvane::Veldra::Bench
