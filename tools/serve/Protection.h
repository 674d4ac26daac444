// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The certificate and the passwords: read from their files, and read again.

#pragma once

#include "host/http/Certificate.h"
#include "host/http/Passwords.h"

#include <memory>

namespace Host::Http {
class Server;
}

namespace Tools {

struct ServeOptions;

class Protection {
public:
    // Throws std::runtime_error naming the file and the reason when one cannot be used. The
    // options must outlive it.
    explicit Protection(const ServeOptions& options);

    // Null where there are none.
    const std::shared_ptr<const Host::Http::Certificate>& certificate() const
    {
        return certificate_;
    }
    const std::shared_ptr<const Host::Http::Passwords>& passwords() const { return passwords_; }

    // Reads the files anew and gives the server what they say. One that cannot be used changes
    // nothing; the log tells of each.
    void renew(Host::Http::Server& server) const;

private:
    const ServeOptions& options_;
    std::shared_ptr<const Host::Http::Certificate> certificate_;
    std::shared_ptr<const Host::Http::Passwords> passwords_;
};

} // namespace Tools
