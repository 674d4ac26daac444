// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Certificate.h"

#include "host/http/EventLog.h"
#include "host/http/SecretFile.h"

#include <gnutls/gnutls.h>
#include <gnutls/x509.h>

#include <ctime>
#include <stdexcept>
#include <type_traits>

namespace Host::Http {

namespace {

template <auto function>
struct Calling {
    template <typename Handle>
    void operator()(Handle* handle) const
    {
        function(handle);
    }
};

using X509 =
    std::unique_ptr<std::remove_pointer_t<gnutls_x509_crt_t>, Calling<gnutls_x509_crt_deinit>>;
using PrivateKey = std::unique_ptr<std::remove_pointer_t<gnutls_x509_privkey_t>,
    Calling<gnutls_x509_privkey_deinit>>;

// Points into the text.
::gnutls_datum_t datumOf(std::string& text)
{
    return {reinterpret_cast<unsigned char*>(text.data()), static_cast<unsigned>(text.size())};
}

void require(int result, const std::string& what)
{
    if (result < 0)
        throw std::runtime_error(what + ": " + ::gnutls_strerror(result));
}

void checkCertificate(std::string& text, const std::string& file)
{
    gnutls_x509_crt_t raw = nullptr;
    require(::gnutls_x509_crt_init(&raw), file);
    const X509 certificate(raw);
    const ::gnutls_datum_t datum = datumOf(text);
    require(::gnutls_x509_crt_import(certificate.get(), &datum, GNUTLS_X509_FMT_PEM),
        file + ": no certificate in PEM form");
    if (::gnutls_x509_crt_get_expiration_time(certificate.get()) < std::time(nullptr))
        report({"checkCertificate", "Certificate", __LINE__},
            file + ": the certificate's time is over, most clients will refuse it");
}

void checkKey(std::string& text, const std::string& file)
{
    gnutls_x509_privkey_t raw = nullptr;
    require(::gnutls_x509_privkey_init(&raw), file);
    const PrivateKey key(raw);
    const ::gnutls_datum_t datum = datumOf(text);
    const int result = ::gnutls_x509_privkey_import2(
        key.get(), &datum, GNUTLS_X509_FMT_PEM, nullptr, GNUTLS_PKCS_PLAIN);
    if (result == GNUTLS_E_DECRYPTION_FAILED)
        throw std::runtime_error(file + ": the private key is locked with a password");
    require(result, file + ": no private key in PEM form");
}

} // namespace

void Certificate::Freeing::operator()(::gnutls_certificate_credentials_st* credentials) const
{
    ::gnutls_certificate_free_credentials(credentials);
}

std::shared_ptr<const Certificate> Certificate::read(
    const std::string& certificateFile, const std::string& keyFile)
{
    return std::make_shared<const Certificate>(certificateFile, keyFile);
}

Certificate::Certificate(const std::string& certificateFile, const std::string& keyFile)
    : certificateText_(readPublicFile(certificateFile)), keyText_(readSecretFile(keyFile))
{
    checkCertificate(certificateText_, certificateFile);
    checkKey(keyText_, keyFile);
    gnutls_certificate_credentials_t raw = nullptr;
    require(::gnutls_certificate_allocate_credentials(&raw), certificateFile);
    credentials_.reset(raw);
    const ::gnutls_datum_t certificate = datumOf(certificateText_);
    const ::gnutls_datum_t key = datumOf(keyText_);
    const int result =
        ::gnutls_certificate_set_x509_key_mem(raw, &certificate, &key, GNUTLS_X509_FMT_PEM);
    if (result == GNUTLS_E_CERTIFICATE_KEY_MISMATCH)
        throw std::runtime_error(
            keyFile + ": the private key does not belong to the certificate " + certificateFile);
    require(result, certificateFile);
}

} // namespace Host::Http
