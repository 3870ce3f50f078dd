#include "utilities/NodeIdentity.h"

#include <unistd.h>

#include <climits>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <locale>
#include <mutex>
#include <sstream>

#include "errors/ErrorCodes.h"
#include "errors/VeldraException.h"
#include "utilities/Paths.h"

namespace Korvane::Veldra::VeldraUtilities {
namespace {

std::string ToLowerClassic(std::string text) {
    const auto& classic = std::locale::classic();
    for (char& c : text) c = std::tolower(c, classic);
    return text;
}

// The whole file as text, or empty when it is missing, not a regular file
// or unreadable.
std::string ReadNameFile(const std::filesystem::path& path) {
    std::error_code error;
    if (!std::filesystem::is_regular_file(path, error)) return std::string();
    std::ifstream file(path, std::ios::binary);
    if (!file) return std::string();
    return std::string(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}

}  // namespace

std::string GetHostName() {
    char name[HOST_NAME_MAX + 1] = {};
    if (gethostname(name, sizeof name - 1) != 0) {
        throw MessageBus::VeldraException(ErrorCodes::kException, "Failed to get hostname");
    }
    return name;
}

std::string ComputeNodeName(const std::string& configDirectory) {
    // secure_getenv: under set-user-ID or set-group-ID the caller does not
    // get to name the node.
    const char* fromEnvironment = secure_getenv("VELDRA_NODENAME");
    if (fromEnvironment != nullptr && *fromEnvironment != '\0') {
        return ToLowerClassic(fromEnvironment);
    }
    std::string name = ToLowerClassic(GetHostName());
    const std::string fromFile =
        ToLowerClassic(ReadNameFile(std::filesystem::path(configDirectory) / "NodeName.txt"));
    if (!fromFile.empty() && fromFile != "localhost") name = fromFile;
    return name;
}

std::string GetNodeName() {
    static std::mutex mutex;
    static std::string cached;
    std::lock_guard<std::mutex> lock(mutex);
    if (cached.empty()) cached = ComputeNodeName(GetConfigDirectory());
    return cached;
}

}  // namespace Korvane::Veldra::VeldraUtilities
