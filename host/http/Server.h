// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// CIM operations over HTTP.

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "host/http/Address.h"
#include "host/http/Limits.h"
#include "host/http/ListeningSocket.h"

#include <chrono>
#include <memory>
#include <vector>

namespace Host::Http {

class Certificate;
class Passwords;

// Serves clients on threads of its own, from its construction to its end. It touches no signal;
// its failures with single clients go to the log. Thread-safe.
class Server {
public:
    // The certificate is needed where a socket is encrypted; without passwords nobody signs in.
    // The operations must outlive it. Throws std::runtime_error and std::system_error when it
    // cannot start.
    Server(CimXml::OperationHandler& operations, std::vector<ListeningSocket> sockets,
        const Limits& limits, std::shared_ptr<const Certificate> certificate = nullptr,
        std::shared_ptr<const Passwords> passwords = nullptr);
    // Ends what clients wait for, but waits for operations that run and for those in the queue.
    ~Server();
    Server(const Server&) = delete;
    Server& operator=(const Server&) = delete;

    // Connections that begin from now on are shown the new one.
    void replaceCertificate(std::shared_ptr<const Certificate> certificate);
    // All clients must sign in anew. REQUIRES: there were passwords before.
    void replacePasswords(std::shared_ptr<const Passwords> passwords);

    // Takes no further clients, and of those that are there no further requests. Idempotent.
    void stopAccepting();
    // Waits until no request is at work, at most so long; whether that is so then.
    bool waitUntilQuiet(std::chrono::milliseconds patience);

private:
    class Parts;

    std::unique_ptr<Parts> parts_;
};

} // namespace Host::Http
