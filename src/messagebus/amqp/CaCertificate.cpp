#include "messagebus/amqp/CaCertificate.h"

#include <openssl/asn1.h>
#include <openssl/err.h>
#include <openssl/pem.h>

#include <cctype>

#include "errors/VeldraException.h"
#include "errors/ErrorCodes.h"

namespace Korvane::Veldra::MessageBus {
namespace {

// The number in text[at, at + digits), or -1 when a character is no digit.
int ReadDigits(const std::string& text, std::size_t at, std::size_t digits) {
    int value = 0;
    for (std::size_t i = at; i < at + digits; ++i) {
        if (!std::isdigit(static_cast<unsigned char>(text[i]))) return -1;
        value = value * 10 + (text[i] - '0');
    }
    return value;
}

std::optional<std::time_t> TimeOf(const ASN1_TIME* time) {
    if (time == nullptr) return std::nullopt;
    const std::string text(reinterpret_cast<const char*>(ASN1_STRING_get0_data(time)),
                           static_cast<std::size_t>(ASN1_STRING_length(time)));
    return ParseAsn1Time(ASN1_STRING_type(time), text);
}

[[noreturn]] void ThrowLoadFailure(const std::string& path, const char* step) {
    std::string text = "Failed to load SSL certificate from path '" + path + "'." + step;
    while (const unsigned long code = ERR_get_error()) {
        char line[256];
        ERR_error_string_n(code, line, sizeof line);
        text += "\n OpenSSL error " + std::to_string(code) + ": " + line;
    }
    throw VeldraException(ErrorCodes::kFailedToLoadCertificate, text);
}

}  // namespace

std::optional<std::time_t> ParseAsn1Time(int kind, const std::string& text) {
    int year = 0;
    std::size_t at = 0;
    if (kind == kAsn1UtcTime) {
        year = text.size() >= 12 ? ReadDigits(text, 0, 2) : -1;
        if (year >= 0) year += year < 70 ? 2000 : 1900;
        at = 2;
    } else if (kind == kAsn1GeneralizedTime) {
        year = text.size() >= 14 ? ReadDigits(text, 0, 4) : -1;
        at = 4;
    } else {
        return std::nullopt;
    }
    if (year < 0) return std::nullopt;
    int fields[5];
    for (int& field : fields) {
        field = ReadDigits(text, at, 2);
        if (field < 0) return std::nullopt;
        at += 2;
    }
    std::tm parts{};
    parts.tm_year = year - 1900;
    parts.tm_mon = fields[0] - 1;
    parts.tm_mday = fields[1];
    parts.tm_hour = fields[2];
    parts.tm_min = fields[3];
    parts.tm_sec = fields[4];
    return timegm(&parts);
}

CaCertificate::CaCertificate(const std::string& path) {
    ERR_clear_error();
    bio_ = BIO_new(BIO_s_file());
    if (bio_ == nullptr || BIO_read_filename(bio_, path.c_str()) <= 0) {
        BIO_free_all(bio_);
        ThrowLoadFailure(path, "  BIO read filename failed.");
    }
    certificate_ = PEM_read_bio_X509(bio_, nullptr, nullptr, nullptr);
    if (certificate_ == nullptr) {
        BIO_free_all(bio_);
        ThrowLoadFailure(path, " PEM read failed.");
    }
}

CaCertificate::~CaCertificate() {
    X509_free(certificate_);
    BIO_free_all(bio_);
}

std::optional<std::time_t> CaCertificate::NotBefore() const {
    return TimeOf(X509_get0_notBefore(certificate_));
}

std::optional<std::time_t> CaCertificate::NotAfter() const {
    return TimeOf(X509_get0_notAfter(certificate_));
}

bool CaCertificate::IsExpiredAt(std::time_t now) const {
    const auto notBefore = NotBefore();
    const auto notAfter = NotAfter();
    return notBefore && notAfter && (now < *notBefore || *notAfter < now);
}

}  // namespace Korvane::Veldra::MessageBus
