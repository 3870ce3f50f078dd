#pragma once

#include <openssl/bio.h>
#include <openssl/x509.h>

#include <ctime>
#include <optional>
#include <string>

namespace Korvane::Veldra::MessageBus {

// ASN.1 tag numbers of the two time kinds a certificate uses.
constexpr int kAsn1UtcTime = 23;
constexpr int kAsn1GeneralizedTime = 24;

// A certificate time as seconds since the epoch. UTCTime has a two-digit
// year, read as 20yy below 70 and 19yy from 70; GeneralizedTime has four
// digits; month, day, hour, minute and second follow in pairs, in UTC.
// Nothing for another kind or text that does not have those digits.
std::optional<std::time_t> ParseAsn1Time(int kind, const std::string& text);

// A PEM certificate read from a file, released with the object. A failure
// throws VeldraException with the code of "Veldra.FailedToLoadCertificate" and
// the lines of the OpenSSL error queue.
class CaCertificate {
public:
    explicit CaCertificate(const std::string& path);
    ~CaCertificate();
    CaCertificate(const CaCertificate&) = delete;
    CaCertificate& operator=(const CaCertificate&) = delete;

    X509* Get() const { return certificate_; }
    std::optional<std::time_t> NotBefore() const;
    std::optional<std::time_t> NotAfter() const;
    // Whether the time lies before notBefore or after notAfter; false when
    // either cannot be read, since nothing then shows an expiry.
    bool IsExpiredAt(std::time_t now) const;

private:
    BIO* bio_ = nullptr;
    X509* certificate_ = nullptr;
};

}  // namespace Korvane::Veldra::MessageBus
