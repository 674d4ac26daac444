// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Server.h"

#include "host/http/Daemon.h"
#include "host/http/Service.h"

#include <list>
#include <utility>

namespace Host::Http {

struct Server::Parts {
    Parts(CimXml::OperationHandler& operations, const Limits& limits,
        std::shared_ptr<const Certificate> certificate, std::shared_ptr<const Passwords> passwords)
        : service(operations, limits, std::move(certificate), std::move(passwords))
    {
    }
    // The daemons wait for the threads of their connections, which may wait for the shutdown.
    ~Parts() { beginShutdown(); }
    Parts(const Parts&) = delete;
    Parts& operator=(const Parts&) = delete;

    void beginShutdown()
    {
        for (Daemon& daemon : daemons)
            daemon.stopAccepting();
        service.connections.beginShutdown();
    }

    Service service;
    std::list<Daemon> daemons;
};

Server::Server(CimXml::OperationHandler& operations, std::vector<ListeningSocket> sockets,
    const Limits& limits, std::shared_ptr<const Certificate> certificate,
    std::shared_ptr<const Passwords> passwords)
    : parts_(
          std::make_unique<Parts>(operations, limits, std::move(certificate), std::move(passwords)))
{
    for (ListeningSocket& socket : sockets)
        parts_->daemons.emplace_back(parts_->service, std::move(socket));
}

Server::~Server() = default;

void Server::replaceCertificate(std::shared_ptr<const Certificate> certificate)
{
    parts_->service.certificate.replace(std::move(certificate));
}

void Server::replacePasswords(std::shared_ptr<const Passwords> passwords)
{
    parts_->service.signIns.replacePasswords(std::move(passwords));
}

void Server::beginShutdown()
{
    parts_->beginShutdown();
}

bool Server::waitUntilIdle(std::chrono::milliseconds timeout)
{
    return parts_->service.connections.waitUntilIdle(timeout);
}

} // namespace Host::Http
