#include "messagebus/amqp/TlsSocketRules.h"

#include <filesystem>

#include "utilities/Paths.h"

namespace Korvane::Veldra::MessageBus {

bool VerifiesHostName(const std::string& host) {
    if (host.find(':') != std::string::npos) return false;
    return host.find_first_not_of("0123456789.") != std::string::npos;
}

std::string ResolveCaCertificatePath(const std::string& certPath) {
    return ResolveCaCertificatePath(certPath, VeldraUtilities::GetDataDirectory());
}

std::string ResolveCaCertificatePath(const std::string& certPath, const std::string& dataRoot) {
    const std::filesystem::path path(certPath);
    if (path.has_parent_path()) return certPath;
    return (std::filesystem::path(dataRoot) / "Certificates" / path).string();
}

}  // namespace Korvane::Veldra::MessageBus
