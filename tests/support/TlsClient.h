// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An HTTP client over TLS. It accepts any certificate.

#pragma once

#include "tests/support/HttpClient.h"

#include <gnutls/gnutls.h>

#include <memory>
#include <string>
#include <type_traits>

namespace Testing {

class TlsClient : public HttpClient {
public:
    // The priorities select the versions of TLS. Throws std::runtime_error when the server supports
    // none of them.
    explicit TlsClient(std::uint16_t port, const std::string& priorities = "NORMAL");

    // Returns the subject of the server's certificate.
    std::string subject() const;
    // Returns the negotiated version, such as TLS1.3.
    std::string version() const;

protected:
    ::ssize_t write(const char* bytes, std::size_t count) override;
    ::ssize_t read(char* bytes, std::size_t count) override;

private:
    struct Freeing {
        void operator()(gnutls_session_t session) const { ::gnutls_deinit(session); }
        void operator()(gnutls_certificate_credentials_t credentials) const
        {
            ::gnutls_certificate_free_credentials(credentials);
        }
    };

    std::unique_ptr<std::remove_pointer_t<gnutls_certificate_credentials_t>, Freeing> credentials_;
    std::unique_ptr<std::remove_pointer_t<gnutls_session_t>, Freeing> session_;
};

// Writes a certificate for the name and its key as PEM files, whose names end in .crt and .key.
void makeCertificate(const std::string& fileWithoutEnding, const std::string& name);

} // namespace Testing
