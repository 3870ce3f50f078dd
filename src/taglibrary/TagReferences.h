#pragma once

#include <cstdint>

namespace Korvane::Veldra::TagLibrary {

// Hands out the 32-bit numbers by which callers hold open tags. On a 64-bit
// build an address does not fit, so each TagData takes a number that is unique
// among the live records and never 0, and gives it back when it dies.
class TagReferences {
public:
    static uint32_t Acquire();
    static void Release(uint32_t reference);
};

}  // namespace Korvane::Veldra::TagLibrary
