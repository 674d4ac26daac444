// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the server shows of itself to clients that use TLS.

#pragma once

#include <memory>
#include <string>

struct gnutls_certificate_credentials_st;

namespace Host::Http {

// A certificate with those that lead to its authority, and its private key. Immutable.
class Certificate {
public:
    // Both files in PEM form, the key without a password. Throws std::runtime_error naming the
    // file and the reason when one cannot be used or both do not belong together; the key's is a
    // secret (see SecretFile.h). One whose time is over is told to the log.
    static std::shared_ptr<const Certificate> read(
        const std::string& certificateFile, const std::string& keyFile);

    Certificate(const std::string& certificateFile, const std::string& keyFile);

    const std::string& certificateText() const { return certificateText_; }
    const std::string& keyText() const { return keyText_; }
    // Belongs to this object.
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
