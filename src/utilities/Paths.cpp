#include "utilities/Paths.h"

#include <cstdlib>
#include <filesystem>

#include "errors/ErrorCodes.h"
#include "errors/VeldraException.h"

namespace Korvane::Veldra::VeldraUtilities {
namespace {

std::string ReadDataDirectory() {
    // secure_getenv: a set-user-ID or set-group-ID program must not let its
    // caller move the data root (and with it the configuration and keys).
    const char* overridden = secure_getenv("VELDRA_DATA_DIR");
    if (overridden != nullptr && *overridden != '\0') return overridden;
    return "/etc/korvane/kvveldra";
}

}  // namespace

const std::string& GetDataDirectory() {
    static const std::string root = ReadDataDirectory();
    return root;
}

std::string GetConfigDirectory() {
    return (std::filesystem::path(GetDataDirectory()) / "Config").string();
}

std::string GetLogDirectory() {
    return (std::filesystem::path(GetDataDirectory()) / "Logs").string();
}

const std::string& GetApplicationDirectory() {
    static const std::string directory;
    if (directory.empty()) {
        throw new MessageBus::VeldraException(ErrorCodes::kException,
                                              "Could not determine Application Directory");
    }
    return directory;
}

std::string GetDefaultProductName() {
    return "KV Fenmark";
}

void GetDefaultProductName(std::string& name) {
    name = GetDefaultProductName();
}

}  // namespace Korvane::Veldra::VeldraUtilities
