#pragma once

#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

namespace Korvane::Veldra::TagIngestion {

// The numeric layer of the errors: full name to code, and the formatted
// texts. One object per reservation cycle, shared by every Client.
class Errors {
public:
    Errors() = default;

    // Registers every row of the table into the registry and the name map.
    void initialize();
    // The code of a full name; an unregistered name gives -251000.
    int32_t codeForName(const std::string& fullName) const;
    // Writes the full name and returns true; "Unknown" and false when absent.
    bool nameForCode(int32_t code, std::string& fullName) const;
    std::string messageForName(const std::string& fullName,
                               const std::vector<std::string>& inserts = {}) const;
    std::string messageForCode(int32_t code, const std::vector<std::string>& inserts = {}) const;

private:
    void RequireInitialized() const;

    bool initialized_ = false;
    std::unordered_map<std::string, int32_t> codes_;
};

}  // namespace Korvane::Veldra::TagIngestion
