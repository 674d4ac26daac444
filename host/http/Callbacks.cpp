// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Callbacks.h"

#include "host/http/Daemon.h"
#include "host/http/EventLog.h"
#include "host/http/Service.h"

#include <gnutls/gnutls.h>
#include <sys/socket.h>

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdio>
#include <memory>
#include <new>
#include <string>
#include <string_view>

namespace Host::Http::Callbacks {

namespace {

// Of a query, which nobody here asks for. The library keeps each in the memory for the head, and
// where that is used up neither answers nor ends the connection.
constexpr std::ptrdiff_t maximumArguments = 100;

const Daemon& daemonOf(const void* closure)
{
    return *static_cast<const Daemon*>(closure);
}

// Null where the connection was one too many, or began without memory for it.
ClientConnection* clientOf(MHD_Connection* connection)
{
    const auto* const info =
        ::MHD_get_connection_info(connection, MHD_CONNECTION_INFO_SOCKET_CONTEXT);
    return info == nullptr ? nullptr : static_cast<ClientConnection*>(info->socket_context);
}

// Each connection keeps to the certificate it began with.
std::shared_ptr<const Certificate> showCertificate(const Daemon& daemon, MHD_Connection* connection)
{
    const auto* const info =
        ::MHD_get_connection_info(connection, MHD_CONNECTION_INFO_GNUTLS_SESSION);
    if (!daemon.isEncrypted() || info == nullptr)
        return nullptr;
    auto certificate = daemon.service().certificate.get();
    ::gnutls_credentials_set(static_cast<gnutls_session_t>(info->tls_session),
        GNUTLS_CRD_CERTIFICATE, certificate->handle());
    return certificate;
}

ClientConnection* connected(const Daemon& daemon, MHD_Connection* connection)
{
    const auto* const descriptor =
        ::MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CONNECTION_FD);
    const auto* const address =
        ::MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CLIENT_ADDRESS);
    return daemon.service().connections.add(
        descriptor->connect_fd, Address(address->client_addr), showCertificate(daemon, connection));
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

} // namespace

void connectionChanged(void* daemon, MHD_Connection* connection, void** client,
    MHD_ConnectionNotificationCode what) noexcept
{
    if (what == MHD_CONNECTION_NOTIFY_STARTED) {
        try {
            *client = connected(daemonOf(daemon), connection);
        } catch (...) {
            *client = nullptr; // its requests end without an answer
        }
    } else if (*client != nullptr) {
        auto& ended = *static_cast<ClientConnection*>(*client);
        ended.exchange.reset();
        daemonOf(daemon).service().connections.remove(ended);
        *client = nullptr;
    }
}

void* requestBegins(void* daemon, const char* uri, MHD_Connection* connection) noexcept
{
    ClientConnection* const client = clientOf(connection);
    if (client == nullptr)
        return nullptr;
    daemonOf(daemon).service().connections.enter(*client, Phase::receiving);
    client->target.clear();
    try {
        const std::string_view target = uri == nullptr ? "" : uri;
        if (std::count(target.begin(), target.end(), '&') < maximumArguments) {
            client->target = target;
            return nullptr;
        }
        mention({"requestBegins", "Callbacks", __LINE__},
            "a request from " + client->address + " has too many arguments");
    } catch (...) {
        report({"requestBegins", "Callbacks", __LINE__}, "no memory for a request");
    }
    ::shutdown(client->descriptor, SHUT_RDWR);
    return nullptr;
}

MHD_Result requestGoesOn(void* daemon, MHD_Connection* connection, const char*, const char* method,
    const char* version, const char* piece, std::size_t* size, void**) noexcept
{
    ClientConnection* const client = clientOf(connection);
    if (client == nullptr)
        return MHD_NO;
    try {
        if (!client->exchange) {
            client->exchange.emplace(daemonOf(daemon).service(), *client, *connection);
            const bool isWell = client->exchange->begin(
                headOf(connection, client->target, method, version), headSizeOf(connection));
            return isWell ? MHD_YES : MHD_NO;
        }
        const std::string_view bytes(piece, *size);
        *size = 0;
        return client->exchange->proceed(bytes) ? MHD_YES : MHD_NO;
    } catch (...) {
        report({"requestGoesOn", "Callbacks", __LINE__}, "no memory for a request");
        return MHD_NO;
    }
}

void requestEnded(
    void* daemon, MHD_Connection* connection, void**, MHD_RequestTerminationCode) noexcept
{
    ClientConnection* const client = clientOf(connection);
    if (client == nullptr)
        return;
    client->exchange.reset();
    daemonOf(daemon).service().connections.enter(*client, Phase::idle);
}

void logLine(void*, const char* format, std::va_list arguments) noexcept
{
    std::array<char, 512> text{};
    std::vsnprintf(text.data(), text.size(), format, arguments);
    std::string_view line = text.data();
    while (line.ends_with('\n'))
        line.remove_suffix(1);
    try {
        mention({"logLine", "Callbacks", __LINE__}, std::string(line));
    } catch (...) {
        return; // a line less
    }
}

} // namespace Host::Http::Callbacks
