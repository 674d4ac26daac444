// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Certificate.h"
#include "host/http/Passwords.h"

#include <memory>

namespace Host::Http {
class Server;
}

namespace Tools {

struct ServeOptions;

// The certificate and the passwords of a server, from the files that the options name.
class Protection {
public:
    // Throws std::runtime_error naming the file and the reason when one cannot be used. The
    // options must outlive it.
    explicit Protection(const ServeOptions& options);

    // Return null where the options name none.
    const std::shared_ptr<const Host::Http::Certificate>& certificate() const
    {
        return certificate_;
    }
    const std::shared_ptr<const Host::Http::Passwords>& passwords() const { return passwords_; }

    // Reads the files again and replaces the certificate and the passwords of the server. A file
    // that cannot be used changes nothing. The outcome for each is reported to the log.
    void renew(Host::Http::Server& server) const;

private:
    const ServeOptions& options_;
    std::shared_ptr<const Host::Http::Certificate> certificate_;
    std::shared_ptr<const Host::Http::Passwords> passwords_;
};

} // namespace Tools
