#include "StatusLinePump.h"

#include <iostream>
#include <string>

#include "ServiceLog.h"

namespace Korvane::Veldra::TagService {

namespace {
constexpr uint32_t kTakeTimeoutMs = 200;
}

StatusLinePump::StatusLinePump(MessageBus::AmqpConnectionManager& manager)
    : manager_(manager), thread_([this] { Run(); }) {}

StatusLinePump::~StatusLinePump() {
    stopping_ = true;
    thread_.join();
}

void StatusLinePump::Run() {
    std::string line;
    while (!stopping_) {
        try {
            if (manager_.TakeLog(line, kTakeTimeoutMs)) WriteLogLine(std::cerr, "bus: " + line);
        } catch (const std::exception& error) {
            WriteLogLine(std::cerr, std::string("bus status lines lost: ") + error.what());
            return;
        }
    }
}

}  // namespace Korvane::Veldra::TagService
