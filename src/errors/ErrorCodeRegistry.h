#pragma once

#include <string>
#include <unordered_map>

#include "errors/ErrorCode.h"

namespace Korvane::Veldra::MessageBus {

// The process-wide table from full error name to its record. It is built
// during static initialization with the one "Unknown" record; Errors fills in
// the rest at the first reservation. After that it is only read.
class ErrorCodeRegistry {
public:
    static ErrorCodeRegistry& Instance();

    // Inserts the record, or overwrites the one stored under the same full name.
    ErrorCode registerCode(const std::string& category, const std::string& name,
                           const std::string& message);
    // The stored record, or FromFullName("Unknown") (with no message) when absent.
    ErrorCode lookup(const std::string& fullName) const;
    ErrorCode fromFullName(const std::string& fullName) const;
    static std::string fullName(const ErrorCode& record) { return record.FullName(); }

    ErrorCodeRegistry();
    ErrorCodeRegistry(const ErrorCodeRegistry&) = delete;
    ErrorCodeRegistry& operator=(const ErrorCodeRegistry&) = delete;

private:
    void RequireInitialized() const;

    bool initialized_ = false;
    std::unordered_map<std::string, ErrorCode> records_;
};

}  // namespace Korvane::Veldra::MessageBus
