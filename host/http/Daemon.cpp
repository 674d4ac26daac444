// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Daemon.h"

#include "host/http/Callbacks.h"
#include "host/http/Service.h"

#include <microhttpd.h>

#include <cstddef>
#include <cstdint>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

namespace Host::Http {

namespace {

constexpr const char* tlsVersions = "NORMAL:-VERS-ALL:+VERS-TLS1.3:+VERS-TLS1.2:%SERVER_PRECEDENCE";

// For a head, beside which the beginning of the body or a piece of the answer must find place.
constexpr std::size_t memoryBesideHead = std::size_t{48} << 10;

// Providers run on the threads of the connections.
constexpr std::size_t stackSize = std::size_t{512} << 10;

unsigned flagsFor(const ListeningSocket& socket)
{
    unsigned flags = MHD_USE_POLL_INTERNAL_THREAD | MHD_USE_THREAD_PER_CONNECTION | MHD_USE_ITC |
                     MHD_USE_ERROR_LOG;
    if (socket.isEncrypted())
        flags |= MHD_USE_TLS;
    if (socket.address().isIpv6())
        flags |= MHD_USE_IPv6;
    return flags;
}

} // namespace

void Daemon::Stopping::operator()(MHD_Daemon* daemon) const
{
    ::MHD_stop_daemon(daemon);
}

Daemon::Daemon(Service& service, ListeningSocket socket)
    : service_(service), socket_(std::move(socket))
{
    const auto certificate = isEncrypted() ? service_.certificate.get() : nullptr;
    start(certificate.get());
}

Daemon::~Daemon()
{
    stopAccepting();
    service_.connections.beginShutdown(); // or a thread would sleep until its sign-in is refused
}

void Daemon::start(const Certificate* certificate)
{
    const auto number = [](std::size_t value) { return static_cast<std::intptr_t>(value); };
    const Limits& limits = service_.limits;
    std::vector<MHD_OptionItem> options{
        // First, since it is used from then on.
        {MHD_OPTION_EXTERNAL_LOGGER, reinterpret_cast<std::intptr_t>(&Callbacks::logLine), this},
        {MHD_OPTION_LISTEN_SOCKET, socket_.descriptor(), nullptr},
        {MHD_OPTION_CONNECTION_MEMORY_LIMIT, number(limits.maximumHeader + memoryBesideHead),
            nullptr},
        // One more than there may be, so that one too many is told.
        {MHD_OPTION_CONNECTION_LIMIT, number(limits.maximumConnections + 1), nullptr},
        {MHD_OPTION_THREAD_STACK_SIZE, number(stackSize), nullptr},
        {MHD_OPTION_CONNECTION_TIMEOUT, static_cast<std::intptr_t>(limits.idleTimeout.count()),
            nullptr},
        {MHD_OPTION_NOTIFY_CONNECTION,
            reinterpret_cast<std::intptr_t>(&Callbacks::connectionChanged), this},
        {MHD_OPTION_URI_LOG_CALLBACK, reinterpret_cast<std::intptr_t>(&Callbacks::requestBegins),
            this},
        {MHD_OPTION_NOTIFY_COMPLETED, reinterpret_cast<std::intptr_t>(&Callbacks::requestEnded),
            this},
    };
    if (certificate != nullptr) {
        options.push_back({MHD_OPTION_HTTPS_MEM_CERT, 0,
            const_cast<char*>(certificate->certificateText().c_str())});
        options.push_back(
            {MHD_OPTION_HTTPS_MEM_KEY, 0, const_cast<char*>(certificate->keyText().c_str())});
        options.push_back({MHD_OPTION_HTTPS_PRIORITIES, 0, const_cast<char*>(tlsVersions)});
    }
    options.push_back({MHD_OPTION_END, 0, nullptr});
    daemon_.reset(::MHD_start_daemon(flagsFor(socket_), 0, nullptr, nullptr,
        &Callbacks::requestGoesOn, this, MHD_OPTION_ARRAY, options.data(), MHD_OPTION_END));
    if (!daemon_)
        throw std::runtime_error("cannot serve " + socket_.address().text() +
                                 ": the HTTP library did not start, the log may tell why");
}

void Daemon::stopAccepting()
{
    if (!std::exchange(isAccepting_, false))
        return;
    ::MHD_quiesce_daemon(daemon_.get());
    socket_.refuse(); // the library's thread may be about to accept from it
}

} // namespace Host::Http
