#include "taglibrary/exports/ProcessState.h"

namespace Korvane::Veldra::TagLibrary {

ProcessState& ProcessState::Get() {
    static ProcessState state;
    return state;
}

}  // namespace Korvane::Veldra::TagLibrary
