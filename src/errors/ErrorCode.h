#pragma once

#include <string>

namespace Korvane::Veldra::MessageBus {

// Category, name and message text of one error. The full name is
// "Category.Name", or the name alone when the category is empty.
struct ErrorCode {
    std::string category;
    std::string name;
    std::string message;

    std::string FullName() const;
    // Splits at the first "." into category and name; the message stays empty.
    static ErrorCode FromFullName(const std::string& fullName);
};

}  // namespace Korvane::Veldra::MessageBus
