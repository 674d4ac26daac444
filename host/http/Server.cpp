// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Server.h"

#include "host/http/Daemon.h"
#include "host/http/Service.h"

#include <utility>

namespace Host::Http {

Server::Server(CimXml::OperationHandler& operations, std::vector<ListeningSocket> sockets,
    const Limits& limits, std::shared_ptr<const Certificate> certificate,
    std::shared_ptr<const Passwords> passwords, Resources resources, ResponseCounts* responses)
    : service_(std::make_unique<Service>(operations, std::move(resources), limits,
          std::move(certificate), std::move(passwords), responses))
{
    for (ListeningSocket& socket : sockets)
        daemons_.emplace_back(*service_, std::move(socket));
}

Server::~Server()
{
    beginShutdown();
}

void Server::replaceCertificate(std::shared_ptr<const Certificate> certificate)
{
    service_->certificate.replace(std::move(certificate));
}

void Server::replacePasswords(std::shared_ptr<const Passwords> passwords)
{
    service_->signIns.replacePasswords(std::move(passwords));
    service_->connections.endStreams(); // whose clients sign in again
}

void Server::beginShutdown()
{
    for (Daemon& daemon : daemons_)
        daemon.stopAccepting();
    service_->connections.beginShutdown();
}

bool Server::waitUntilIdle(std::chrono::milliseconds timeout)
{
    return service_->connections.waitUntilIdle(timeout);
}

} // namespace Host::Http
