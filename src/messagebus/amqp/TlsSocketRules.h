#pragma once

#include <string>

namespace Korvane::Veldra::MessageBus {

// Whether the broker's certificate must name the host: true for a host name,
// false for a literal address (any ":" makes an IPv6 form, and only digits and
// dots make an IPv4 form). The peer's chain is verified in every case.
bool VerifiesHostName(const std::string& host);

// The CA file of a configuration: a bare file name lies in "Certificates"
// under the data root; a path with a directory stands as given.
std::string ResolveCaCertificatePath(const std::string& certPath);
std::string ResolveCaCertificatePath(const std::string& certPath, const std::string& dataRoot);

}  // namespace Korvane::Veldra::MessageBus
