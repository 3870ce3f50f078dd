#include "errors/ErrorCodeRegistry.h"

#include "errors/VeldraException.h"

namespace Korvane::Veldra::MessageBus {
namespace {

// A namespace-scope object, so that a use from another unit's static
// initializer finds the flag still false (zero-initialized) and is refused.
ErrorCodeRegistry gRegistry;

}  // namespace

ErrorCodeRegistry& ErrorCodeRegistry::Instance() {
    return gRegistry;
}

ErrorCodeRegistry::ErrorCodeRegistry() {
    records_.emplace("Unknown", ErrorCode{"", "Unknown", "An unknown error occurred."});
    initialized_ = true;
}

void ErrorCodeRegistry::RequireInitialized() const {
    if (!initialized_) {
        throw new VeldraException(
            -251004,
            "Error code registry is not initialized and should not be called from a static "
            "context.");
    }
}

ErrorCode ErrorCodeRegistry::registerCode(const std::string& category, const std::string& name,
                                          const std::string& message) {
    RequireInitialized();
    ErrorCode record{category, name, message};
    records_[record.FullName()] = record;
    return record;
}

ErrorCode ErrorCodeRegistry::lookup(const std::string& fullName) const {
    RequireInitialized();
    const auto found = records_.find(fullName);
    if (found == records_.end()) return fromFullName("Unknown");
    return found->second;
}

ErrorCode ErrorCodeRegistry::fromFullName(const std::string& fullName) const {
    RequireInitialized();
    return ErrorCode::FromFullName(fullName);
}

}  // namespace Korvane::Veldra::MessageBus
