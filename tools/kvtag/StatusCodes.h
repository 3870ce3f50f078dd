#pragma once

#include <cstdint>

namespace kvtag {

// The library's status codes that kvtag tells apart, by the names the
// library registers them under.
namespace status {
inline constexpr int32_t kRequestTimedOut = -251001;       // Veldra.RequestTimedOut
inline constexpr int32_t kException = -251004;             // Veldra.Exception
inline constexpr int32_t kFailedToParse = -251005;         // Veldra.FailedToParse
inline constexpr int32_t kNoConfigurations = -251011;      // Veldra.NoVeldraConfigurations
inline constexpr int32_t kDirectoryNotFound = -251012;     // Veldra.ConfigDirectoryNotFound
inline constexpr int32_t kDuplicateId = -251013;           // Veldra.DuplicateConfigurationId
inline constexpr int32_t kSettingCaCertificate = -251023;  // Veldra.AMQPErrorSettingCACertificate
inline constexpr int32_t kFailedToLogIn = -251024;         // Veldra.AMQPErrorFailedToLogIn
inline constexpr int32_t kCertificateExpired = -251034;    // Veldra.AMQPErrorCertificateExpired
inline constexpr int32_t kPeerVerifyFailed = -251035;      // Veldra.AMQPErrorPeerVerifyFailed
inline constexpr int32_t kFailedToLoadCertificate = -251036;  // Veldra.FailedToLoadCertificate
}  // namespace status

// The registered text of a time-out, for a wait that kvtag itself ends.
inline constexpr const char* kRequestTimedOutText = "Request timed out.";

}  // namespace kvtag
