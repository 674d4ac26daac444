// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/support/TlsClient.h"

#include <gnutls/x509.h>

#include <array>
#include <cerrno>
#include <cstdlib>
#include <stdexcept>

namespace Testing {

namespace {

void require(int result)
{
    if (result < 0)
        throw std::runtime_error(::gnutls_strerror(result));
}

::ssize_t asSocketResult(::ssize_t result)
{
    if (result >= 0)
        return result;
    errno = result == GNUTLS_E_AGAIN || result == GNUTLS_E_INTERRUPTED ? EAGAIN : ECONNRESET;
    return -1;
}

} // namespace

TlsClient::TlsClient(std::uint16_t port, const std::string& priorities) : HttpClient(port)
{
    gnutls_certificate_credentials_t credentials = nullptr;
    require(::gnutls_certificate_allocate_credentials(&credentials));
    credentials_.reset(credentials);
    gnutls_session_t session = nullptr;
    require(::gnutls_init(&session, GNUTLS_CLIENT | GNUTLS_NO_SIGNAL));
    session_.reset(session);
    require(::gnutls_priority_set_direct(session, priorities.c_str(), nullptr));
    require(::gnutls_credentials_set(session, GNUTLS_CRD_CERTIFICATE, credentials));
    ::gnutls_transport_set_int(session, descriptor());
    ::gnutls_handshake_set_timeout(
        session, static_cast<unsigned>(std::chrono::milliseconds(timeout).count()));
    int result = 0;
    do
        result = ::gnutls_handshake(session);
    while (result < 0 && ::gnutls_error_is_fatal(result) == 0);
    require(result);
}

std::string TlsClient::subject() const
{
    unsigned count = 0;
    const gnutls_datum_t* const shown = ::gnutls_certificate_get_peers(session_.get(), &count);
    if (shown == nullptr || count == 0)
        throw std::runtime_error("no certificate was shown");
    gnutls_x509_crt_t certificate = nullptr;
    require(::gnutls_x509_crt_init(&certificate));
    std::array<char, 256> text{};
    std::size_t size = text.size();
    const int imported = ::gnutls_x509_crt_import(certificate, shown, GNUTLS_X509_FMT_DER);
    const int result = ::gnutls_x509_crt_get_dn(certificate, text.data(), &size);
    ::gnutls_x509_crt_deinit(certificate);
    require(imported);
    require(result);
    return text.data();
}

std::string TlsClient::version() const
{
    return ::gnutls_protocol_get_name(::gnutls_protocol_get_version(session_.get()));
}

::ssize_t TlsClient::write(const char* bytes, std::size_t count)
{
    return asSocketResult(::gnutls_record_send(session_.get(), bytes, count));
}

::ssize_t TlsClient::read(char* bytes, std::size_t count)
{
    for (;;) {
        const ::ssize_t got = ::gnutls_record_recv(session_.get(), bytes, count);
        // In TLS 1.3, messages of the protocol may arrive between the data.
        if (got != GNUTLS_E_AGAIN && got != GNUTLS_E_INTERRUPTED)
            return asSocketResult(got);
    }
}

void makeCertificate(const std::string& fileWithoutEnding, const std::string& name)
{
    const std::string command = "openssl req -x509 -newkey ec -pkeyopt ec_paramgen_curve:P-256 "
                                "-nodes -days 2 -subj '/CN=" +
                                name + "' -keyout '" + fileWithoutEnding + ".key' -out '" +
                                fileWithoutEnding + ".crt' 2>/dev/null && chmod 600 '" +
                                fileWithoutEnding + ".key'";
    if (std::system(command.c_str()) != 0)
        throw std::runtime_error("openssl cannot make a certificate");
}

} // namespace Testing
