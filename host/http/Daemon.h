// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The HTTP library's side of one listening socket.

#pragma once

#include "host/http/ListeningSocket.h"

#include <functional>
#include <memory>

struct MHD_Daemon;

namespace Host::Http {

class Certificate;
struct Service;

// Serves the clients of the socket on a thread of its own.
class Daemon {
public:
    using CertificateSource = std::function<std::shared_ptr<const Certificate>()>;

    // The source is asked for each connection, and must give one where the socket is encrypted.
    // Throws std::runtime_error when the library fails. The service must outlive it.
    Daemon(Service& service, ListeningSocket socket, CertificateSource certificates);
    // REQUIRES: no connection is asleep nor may fall asleep.
    ~Daemon();
    Daemon(const Daemon&) = delete;
    Daemon& operator=(const Daemon&) = delete;

    // With the actual port; stays after stopAccepting().
    const Address& address() const { return socket_.address(); }
    bool isEncrypted() const { return socket_.isEncrypted(); }

    // Nobody can connect any more; those who are connected stay. Idempotent.
    void stopAccepting();

    // For the library's calls back.
    Service& service() const { return service_; }
    std::shared_ptr<const Certificate> certificate() const { return certificates_(); }

private:
    struct Stopping {
        void operator()(MHD_Daemon* daemon) const;
    };

    void start(const Certificate* certificate);

    Service& service_;
    ListeningSocket socket_;
    CertificateSource certificates_;
    std::unique_ptr<MHD_Daemon, Stopping> daemon_;
    bool isAccepting_ = true;
};

} // namespace Host::Http
