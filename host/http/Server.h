// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "host/http/Address.h"
#include "host/http/Limits.h"
#include "host/http/ListeningSocket.h"
#include "host/http/Resource.h"

#include <chrono>
#include <list>
#include <memory>
#include <vector>

namespace Host::Http {

class Certificate;
class Daemon;
class Passwords;
class ResponseCounts;
struct Service;

// Serves clients on threads of its own until it is destroyed. Installs no signal handlers; writes
// failures with single clients to the log. Thread-safe.
class Server {
public:
    // An encrypted socket needs a certificate. Without passwords no client must sign in. The
    // operations, the resources and the counts, to which it adds its responses, must outlive the
    // server. Throws std::runtime_error and std::system_error when it cannot start.
    Server(CimXml::OperationHandler& operations, std::vector<ListeningSocket> sockets,
        const Limits& limits, std::shared_ptr<const Certificate> certificate = nullptr,
        std::shared_ptr<const Passwords> passwords = nullptr, Resources resources = {},
        ResponseCounts* responses = nullptr);
    // Begins the shutdown and closes all connections, but blocks until the operations that run and
    // those in the queue have returned.
    ~Server();
    Server(const Server&) = delete;
    Server& operator=(const Server&) = delete;

    // New connections are shown this certificate.
    void replaceCertificate(std::shared_ptr<const Certificate> certificate);
    // Every client must sign in again. REQUIRES: there were passwords before.
    void replacePasswords(std::shared_ptr<const Passwords> passwords);

    // From now on the server accepts neither connections nor further requests on those it has.
    // Idempotent.
    void beginShutdown();
    // Blocks until no request is in progress, at most for the timeout. Returns whether that was
    // reached.
    bool waitUntilIdle(std::chrono::milliseconds timeout);

private:
    std::unique_ptr<Service> service_;
    std::list<Daemon> daemons_; // last: they use the service until they are destroyed
};

} // namespace Host::Http
