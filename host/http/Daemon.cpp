// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Daemon.h"

#include "host/http/EventLog.h"
#include "host/http/Service.h"

#include <gnutls/gnutls.h>
#include <microhttpd.h>
#include <sys/socket.h>

#include <algorithm>
#include <array>
#include <cstdarg>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <exception>
#include <memory>
#include <new>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Host::Http {

namespace {

constexpr const char* tlsVersions = "NORMAL:-VERS-ALL:+VERS-TLS1.3:+VERS-TLS1.2:%SERVER_PRECEDENCE";

// In addition to the head, a connection's memory holds the beginning of the body or a part of the
// answer.
constexpr std::size_t memoryBesideHead = std::size_t{48} << 10;

// Providers run on the threads of the connections.
constexpr std::size_t stackSize = std::size_t{512} << 10;

// The greatest number of arguments in a query. libmicrohttpd keeps the arguments in the memory for
// the head, and neither answers nor closes the connection when that is used up.
constexpr std::ptrdiff_t maximumArguments = 100;

// The closure of each callback is the Service. No exception leaves a callback.
Service& serviceOf(void* closure)
{
    return *static_cast<Service*>(closure);
}

// Returns null for a connection that exceeded a limit, or for which there was no memory.
ClientConnection* clientOf(MHD_Connection* connection)
{
    const auto* const info =
        ::MHD_get_connection_info(connection, MHD_CONNECTION_INFO_SOCKET_CONTEXT);
    return info == nullptr ? nullptr : static_cast<ClientConnection*>(info->socket_context);
}

int descriptorOf(MHD_Connection* connection)
{
    return ::MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CONNECTION_FD)->connect_fd;
}

// Returns null for a connection that exceeds a limit. Its TLS session keeps the credentials of the
// library, since it may still read what the client sent, and nothing would own a certificate.
ClientConnection* connected(Service& service, MHD_Connection* connection)
{
    const auto* const address =
        ::MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CLIENT_ADDRESS);
    ClientConnection* const client = service.connections.add(
        descriptorOf(connection), Address(address->client_addr), service.certificate.get());
    const auto* const tls =
        ::MHD_get_connection_info(connection, MHD_CONNECTION_INFO_GNUTLS_SESSION);
    if (client != nullptr && tls != nullptr && tls->tls_session != nullptr)
        ::gnutls_credentials_set(static_cast<gnutls_session_t>(tls->tls_session),
            GNUTLS_CRD_CERTIFICATE, client->certificate->handle());
    return client;
}

// Reports the exception that is being handled.
void reportFailure(const Place& place) noexcept
{
    try {
        throw;
    } catch (const std::bad_alloc&) {
        report(place, "no memory for a request", Severity::error);
    } catch (const std::exception& error) {
        report(place, error.what(), Severity::error);
    } catch (...) {
        report(place, "a request failed", Severity::error);
    }
}

MHD_Result addField(void* head, MHD_ValueKind, const char* name, std::size_t nameSize,
    const char* value, std::size_t valueSize)
{
    try {
        static_cast<RequestHead*>(head)->fields.push_back({std::string(name, nameSize),
            value == nullptr ? std::string() : std::string(value, valueSize)});
        return MHD_YES;
    } catch (...) {
        return MHD_NO;
    }
}

RequestHead headOf(
    MHD_Connection* connection, const std::string& target, const char* method, const char* version)
{
    RequestHead head{method, target, version, {}};
    const int count = ::MHD_get_connection_values_n(connection, MHD_HEADER_KIND, nullptr, nullptr);
    head.fields.reserve(static_cast<std::size_t>(count));
    if (::MHD_get_connection_values_n(connection, MHD_HEADER_KIND, &addField, &head) != count)
        throw std::bad_alloc();
    return head;
}

std::size_t headSizeOf(MHD_Connection* connection)
{
    const auto* const info =
        ::MHD_get_connection_info(connection, MHD_CONNECTION_INFO_REQUEST_HEADER_SIZE);
    return info == nullptr ? 0 : info->header_size;
}

void connectionChanged(void* service, MHD_Connection* connection, void** client,
    MHD_ConnectionNotificationCode what) noexcept
{
    if (what == MHD_CONNECTION_NOTIFY_STARTED) {
        try {
            *client = connected(serviceOf(service), connection);
        } catch (...) {
            *client = nullptr;
            ::shutdown(descriptorOf(connection), SHUT_RDWR);
        }
    } else if (*client != nullptr) {
        auto& ended = *static_cast<ClientConnection*>(*client);
        ended.exchange.reset();
        serviceOf(service).connections.remove(ended);
        *client = nullptr;
    }
}

void* requestBegins(void* service, const char* uri, MHD_Connection* connection) noexcept
{
    ClientConnection* const client = clientOf(connection);
    if (client == nullptr)
        return nullptr;
    serviceOf(service).connections.enter(*client, Phase::receiving);
    client->target.clear();
    try {
        const std::string_view target = uri == nullptr ? "" : uri;
        if (std::count(target.begin(), target.end(), '&') < maximumArguments) {
            client->target = target;
            return nullptr;
        }
        reportDetail({"requestBegins", "Daemon", __LINE__},
            "a request from " + client->address + " has too many arguments");
    } catch (...) {
        reportFailure({"requestBegins", "Daemon", __LINE__});
    }
    ::shutdown(client->descriptor, SHUT_RDWR);
    return nullptr;
}

MHD_Result requestGoesOn(void* service, MHD_Connection* connection, const char*, const char* method,
    const char* version, const char* piece, std::size_t* size, void**) noexcept
{
    ClientConnection* const client = clientOf(connection);
    if (client == nullptr)
        return MHD_NO;
    try {
        if (!client->exchange) {
            client->exchange.emplace(serviceOf(service), *client, *connection);
            const bool isWell = client->exchange->begin(
                headOf(connection, client->target, method, version), headSizeOf(connection));
            return isWell ? MHD_YES : MHD_NO;
        }
        const std::string_view bytes(piece, *size);
        *size = 0;
        return client->exchange->proceed(bytes) ? MHD_YES : MHD_NO;
    } catch (...) {
        reportFailure({"requestGoesOn", "Daemon", __LINE__});
        return MHD_NO;
    }
}

void requestEnded(
    void* service, MHD_Connection* connection, void**, MHD_RequestTerminationCode) noexcept
{
    ClientConnection* const client = clientOf(connection);
    if (client == nullptr)
        return;
    client->exchange.reset();
    serviceOf(service).connections.enter(*client, Phase::idle);
}

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
    const auto certificate = socket_.isEncrypted() ? service_.certificate.get() : nullptr;
    start(certificate.get());
}

Daemon::~Daemon()
{
    stopAccepting();
    service_.connections.beginShutdown(); // no thread waits until its sign-in is refused
    // libmicrohttpd 0.9.75 dereferences null when it is stopped while it refuses a request by
    // itself.
    service_.connections.closeAll();
}

void Daemon::logLine(void* daemon, const char* format, std::va_list arguments) noexcept
{
    std::array<char, 512> text{};
    std::vsnprintf(text.data(), text.size(), format, arguments);
    std::string_view line = text.data();
    while (line.ends_with('\n'))
        line.remove_suffix(1);
    auto& self = *static_cast<Daemon*>(daemon);
    // Most lines are about what single clients did; "Failed to create a new thread" is not.
    const bool isFailure = line.find("Failed") != std::string_view::npos;
    const bool isReported = !self.isStarted_ || (isFailure && self.lines_.allowsReport());
    const Place place{"logLine", "Daemon", __LINE__};
    if (isReported)
        report(place, line);
    else
        reportDetail(place, line);
}

void Daemon::start(const Certificate* certificate)
{
    const auto number = [](std::size_t value) { return static_cast<std::intptr_t>(value); };
    const Limits& limits = service_.limits;
    std::vector<MHD_OptionItem> options{
        // This option comes first, so that what the library reports of the others is logged.
        {MHD_OPTION_EXTERNAL_LOGGER, reinterpret_cast<std::intptr_t>(&logLine), this},
        {MHD_OPTION_LISTEN_SOCKET, socket_.descriptor(), nullptr},
        {MHD_OPTION_CONNECTION_MEMORY_LIMIT, number(limits.maximumHeader + memoryBesideHead),
            nullptr},
        // One more than the limit, so that Connections can report the one that exceeds it.
        {MHD_OPTION_CONNECTION_LIMIT, number(limits.maximumConnections + 1), nullptr},
        {MHD_OPTION_THREAD_STACK_SIZE, number(stackSize), nullptr},
        {MHD_OPTION_CONNECTION_TIMEOUT, static_cast<std::intptr_t>(limits.idleTimeout.count()),
            nullptr},
        {MHD_OPTION_NOTIFY_CONNECTION, reinterpret_cast<std::intptr_t>(&connectionChanged),
            &service_},
        {MHD_OPTION_URI_LOG_CALLBACK, reinterpret_cast<std::intptr_t>(&requestBegins), &service_},
        {MHD_OPTION_NOTIFY_COMPLETED, reinterpret_cast<std::intptr_t>(&requestEnded), &service_},
    };
    if (certificate != nullptr) {
        options.push_back({MHD_OPTION_HTTPS_MEM_CERT, 0,
            const_cast<char*>(certificate->certificateText().c_str())});
        options.push_back(
            {MHD_OPTION_HTTPS_MEM_KEY, 0, const_cast<char*>(certificate->keyText().c_str())});
        options.push_back({MHD_OPTION_HTTPS_PRIORITIES, 0, const_cast<char*>(tlsVersions)});
    }
    options.push_back({MHD_OPTION_END, 0, nullptr});
    daemon_.reset(::MHD_start_daemon(flagsFor(socket_), 0, nullptr, nullptr, &requestGoesOn,
        &service_, MHD_OPTION_ARRAY, options.data(), MHD_OPTION_END));
    if (!daemon_)
        throw std::runtime_error("cannot serve " + socket_.address().text() +
                                 ": the HTTP library did not start, the log may have the reason");
    isStarted_ = true;
}

void Daemon::stopAccepting()
{
    if (!std::exchange(isAccepting_, false))
        return;
    ::MHD_quiesce_daemon(daemon_.get());
    socket_.refuse(); // the library's thread may be about to accept from it
}

} // namespace Host::Http
