#include "taglibrary/exports/ErrorOut.h"

#include "taglibrary/exports/wb/HostStrings.h"

namespace Korvane::Veldra::TagLibrary {

int32_t HostErrorOut::Report(int32_t status, const std::string& text) {
    const int32_t copied = CopyToHostString(target_, text);
    return copied == 0 ? status : copied;
}

}  // namespace Korvane::Veldra::TagLibrary
