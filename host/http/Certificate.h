// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <memory>
#include <string>

struct gnutls_certificate_credentials_st;

namespace Host::Http {

// A server's certificate chain and private key for TLS. Immutable.
class Certificate {
public:
    // Reads both files, in PEM form, the key without a password and by readSecretFile. Throws
    // std::runtime_error with the file and the reason when one cannot be used or both do not belong
    // together. An expired certificate is reported to the log.
    static std::shared_ptr<const Certificate> read(
        const std::string& certificateFile, const std::string& keyFile);

    Certificate(const std::string& certificateFile, const std::string& keyFile);

    const std::string& certificateText() const { return certificateText_; }
    const std::string& keyText() const { return keyText_; }
    // Returns a handle that this object owns.
    ::gnutls_certificate_credentials_st* handle() const { return credentials_.get(); }

private:
    struct Freeing {
        void operator()(::gnutls_certificate_credentials_st* credentials) const;
    };

    std::string certificateText_;
    std::string keyText_;
    std::unique_ptr<::gnutls_certificate_credentials_st, Freeing> credentials_;
};

} // namespace Host::Http
