#include "errors/Errors.h"

#include "errors/ErrorCodeRegistry.h"
#include "errors/ErrorCodes.h"
#include "errors/ErrorTable.h"
#include "errors/MessageInserts.h"
#include "errors/VeldraException.h"

namespace Korvane::Veldra::TagIngestion {

using MessageBus::ErrorCodeRegistry;
using MessageBus::VeldraException;

void Errors::RequireInitialized() const {
    if (!initialized_)
        throw new VeldraException(ErrorCodes::kException, "Errors is not initialized");
}

void Errors::initialize() {
    if (initialized_)
        throw new VeldraException(ErrorCodes::kException, "Errors class is already initialized.");
    std::size_t count = 0;
    const MessageBus::ErrorRow* rows = MessageBus::ErrorRows(count);
    auto& registry = ErrorCodeRegistry::Instance();
    for (std::size_t i = 0; i < count; ++i) {
        registry.registerCode(rows[i].category, rows[i].name, rows[i].message);
    }
    codes_.reserve(count);
    for (std::size_t i = 0; i < count; ++i) {
        codes_[std::string(rows[i].category) + "." + rows[i].name] = rows[i].code;
    }
    initialized_ = true;
}

int32_t Errors::codeForName(const std::string& fullName) const {
    RequireInitialized();
    const auto found = codes_.find(fullName);
    return found == codes_.end() ? ErrorCodes::kInternalServiceError : found->second;
}

bool Errors::nameForCode(int32_t code, std::string& fullName) const {
    RequireInitialized();
    for (const auto& entry : codes_) {
        if (entry.second == code) {
            fullName = entry.first;
            return true;
        }
    }
    fullName = "Unknown";
    return false;
}

std::string Errors::messageForName(const std::string& fullName,
                                   const std::vector<std::string>& inserts) const {
    RequireInitialized();
    return MessageBus::ApplyInserts(ErrorCodeRegistry::Instance().lookup(fullName).message,
                                    inserts);
}

std::string Errors::messageForCode(int32_t code, const std::vector<std::string>& inserts) const {
    RequireInitialized();
    std::string fullName;
    auto& registry = ErrorCodeRegistry::Instance();
    if (!nameForCode(code, fullName)) return registry.lookup("Unknown").message;
    return MessageBus::ApplyInserts(registry.lookup(fullName).message, inserts);
}

}  // namespace Korvane::Veldra::TagIngestion
