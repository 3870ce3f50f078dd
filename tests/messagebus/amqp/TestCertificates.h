#pragma once

#include <openssl/evp.h>
#include <openssl/pem.h>
#include <openssl/rsa.h>
#include <openssl/x509.h>

#include <cstdio>
#include <memory>
#include <stdexcept>
#include <string>

namespace Korvane::Veldra::MessageBus::Testing {

// Writes a self-signed CA certificate in PEM form whose validity runs from
// now + notBeforeSeconds to now + notAfterSeconds. It signs nothing the tests
// connect to, so a broker checked against it fails peer verification.
inline void WriteSelfSignedCa(const std::string& path, long notBeforeSeconds,
                              long notAfterSeconds) {
    std::unique_ptr<EVP_PKEY_CTX, decltype(&EVP_PKEY_CTX_free)> context(
        EVP_PKEY_CTX_new_id(EVP_PKEY_RSA, nullptr), EVP_PKEY_CTX_free);
    EVP_PKEY* rawKey = nullptr;
    if (!context || EVP_PKEY_keygen_init(context.get()) <= 0 ||
        EVP_PKEY_CTX_set_rsa_keygen_bits(context.get(), 2048) <= 0 ||
        EVP_PKEY_keygen(context.get(), &rawKey) <= 0) {
        throw std::runtime_error("key generation failed");
    }
    std::unique_ptr<EVP_PKEY, decltype(&EVP_PKEY_free)> key(rawKey, EVP_PKEY_free);
    std::unique_ptr<X509, decltype(&X509_free)> certificate(X509_new(), X509_free);
    X509_set_version(certificate.get(), 2);
    ASN1_INTEGER_set(X509_get_serialNumber(certificate.get()), 1);
    X509_gmtime_adj(X509_getm_notBefore(certificate.get()), notBeforeSeconds);
    X509_gmtime_adj(X509_getm_notAfter(certificate.get()), notAfterSeconds);
    X509_set_pubkey(certificate.get(), key.get());
    X509_NAME* name = X509_get_subject_name(certificate.get());
    X509_NAME_add_entry_by_txt(name, "CN", MBSTRING_ASC,
                               reinterpret_cast<const unsigned char*>("Unrelated Test CA"), -1, -1,
                               0);
    X509_set_issuer_name(certificate.get(), name);
    if (X509_sign(certificate.get(), key.get(), EVP_sha256()) <= 0) {
        throw std::runtime_error("signing failed");
    }
    std::unique_ptr<FILE, decltype(&fclose)> file(fopen(path.c_str(), "w"), fclose);
    if (!file || PEM_write_X509(file.get(), certificate.get()) != 1) {
        throw std::runtime_error("cannot write " + path);
    }
}

}  // namespace Korvane::Veldra::MessageBus::Testing
