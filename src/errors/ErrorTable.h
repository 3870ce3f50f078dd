#pragma once

#include <cstddef>
#include <cstdint>

namespace Korvane::Veldra::MessageBus {

// One row of the fixed table of error codes, names and texts.
struct ErrorRow {
    int32_t code;
    const char* category;
    const char* name;
    const char* message;
};

// All rows in order of registration.
const ErrorRow* ErrorRows(std::size_t& count);

// The row of a full name, or null. Used where no registry object is at hand.
const ErrorRow* FindErrorRow(const char* fullName);

}  // namespace Korvane::Veldra::MessageBus
