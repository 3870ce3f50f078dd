#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "kvveldra/TagConsole.h"

namespace Korvane::Veldra::Bench {

// Closes each of the console references once.
inline void CloseReferences(const std::vector<uint32_t>& references) {
    std::string ignored;
    for (const uint32_t reference : references) TagConsoleClose(reference, false, &ignored);
}

// Console references that a benchmark holds open, each closed once when the
// object goes or at CloseAll.
class ConsoleReferences {
public:
    ConsoleReferences() = default;
    ~ConsoleReferences() { CloseAll(); }
    ConsoleReferences(const ConsoleReferences&) = delete;
    ConsoleReferences& operator=(const ConsoleReferences&) = delete;

    void Add(uint32_t reference) { references_.push_back(reference); }
    void Reserve(std::size_t count) { references_.reserve(count); }
    std::size_t Size() const { return references_.size(); }
    void CloseAll() {
        CloseReferences(references_);
        references_.clear();
    }

private:
    std::vector<uint32_t> references_;
};

}  // namespace Korvane::Veldra::Bench
