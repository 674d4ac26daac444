// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Server.h"

#include "host/http/Certificate.h"
#include "host/http/Connections.h"
#include "host/http/Daemon.h"
#include "host/http/Exchange.h"
#include "host/http/SignIns.h"
#include "host/http/Timer.h"
#include "host/http/WorkerPool.h"

#include <list>
#include <mutex>
#include <optional>
#include <utility>

namespace Host::Http {

namespace {

// Replaced while connections ask for it.
class CurrentCertificate {
public:
    explicit CurrentCertificate(std::shared_ptr<const Certificate> first)
        : certificate_(std::move(first))
    {
    }

    std::shared_ptr<const Certificate> get() const
    {
        const std::lock_guard lock(mutex_);
        return certificate_;
    }
    void replace(std::shared_ptr<const Certificate> certificate)
    {
        const std::lock_guard lock(mutex_);
        certificate_ = std::move(certificate);
    }

private:
    mutable std::mutex mutex_;
    std::shared_ptr<const Certificate> certificate_;
};

} // namespace

// In the order in which they need one another.
class Server::Parts {
public:
    Parts(CimXml::OperationHandler& operations, std::vector<ListeningSocket> sockets,
        const Limits& limits, std::shared_ptr<const Certificate> first,
        std::shared_ptr<const Passwords> passwords)
        : limits_(limits), certificate_(std::move(first)),
          signIns_(std::move(passwords), limits.signInDelay), connections_(limits_, timer_),
          unsent_(limits.maximumUnsentObjects), workers_(limits.workers, limits.maximumQueue)
    {
        service_.emplace(
            Service{operations, limits_, signIns_, connections_, timer_, workers_, unsent_});
        try {
            for (ListeningSocket& socket : sockets)
                daemons_.emplace_back(
                    *service_, std::move(socket), [this] { return certificate_.get(); });
        } catch (...) {
            end();
            throw;
        }
    }
    ~Parts() { end(); }
    Parts(const Parts&) = delete;
    Parts& operator=(const Parts&) = delete;

    void stopAccepting()
    {
        for (Daemon& daemon : daemons_)
            daemon.stopAccepting();
        connections_.windUp();
        timer_.hurry(); // those who wait for the outcome of their sign-in
    }

    Connections& connections() { return connections_; }
    SignIns& signIns() { return signIns_; }
    CurrentCertificate& certificate() { return certificate_; }

private:
    // The library must not be stopped while it waits for somebody to wake a connection.
    void end()
    {
        stopAccepting();
        connections_.stopWatching();
        timer_.end();
        connections_.waitUntilAllAreAwake();
    }

    const Limits limits_;
    CurrentCertificate certificate_;
    SignIns signIns_;
    Timer timer_;
    Connections connections_;
    UnsentObjects unsent_;
    WorkerPool workers_;
    std::optional<Service> service_;
    std::list<Daemon> daemons_;
};

Server::Server(CimXml::OperationHandler& operations, std::vector<ListeningSocket> sockets,
    const Limits& limits, std::shared_ptr<const Certificate> certificate,
    std::shared_ptr<const Passwords> passwords)
    : parts_(std::make_unique<Parts>(
          operations, std::move(sockets), limits, std::move(certificate), std::move(passwords)))
{
}

Server::~Server() = default;

void Server::replaceCertificate(std::shared_ptr<const Certificate> certificate)
{
    parts_->certificate().replace(std::move(certificate));
}

void Server::replacePasswords(std::shared_ptr<const Passwords> passwords)
{
    parts_->signIns().replacePasswords(std::move(passwords));
}

void Server::stopAccepting()
{
    parts_->stopAccepting();
}

bool Server::waitUntilQuiet(std::chrono::milliseconds patience)
{
    return parts_->connections().waitUntilQuiet(patience);
}

} // namespace Host::Http
