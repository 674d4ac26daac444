// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/ListeningSocket.h"

#include "host/http/EventLog.h"

#include <netinet/in.h>
#include <unistd.h>

#include <cerrno>
#include <map>
#include <system_error>
#include <utility>

namespace Host::Http {

namespace {

void require(int result, const Address& address)
{
    if (result >= 0)
        return;
    throw std::system_error(errno, std::system_category(), "cannot listen on " + address.text());
}

Address actualAddress(int descriptor)
{
    ::sockaddr_storage storage{};
    ::socklen_t size = sizeof storage;
    ::getsockname(descriptor, reinterpret_cast<::sockaddr*>(&storage), &size);
    return Address(reinterpret_cast<const ::sockaddr*>(&storage));
}

bool isMissingAddress(const std::error_code& error)
{
    return error == std::errc::address_family_not_supported ||
           error == std::errc::address_not_available;
}

} // namespace

ListeningSocket::ListeningSocket(const Endpoint& endpoint)
    : address_(endpoint.address), isEncrypted_(endpoint.isEncrypted),
      descriptor_(::socket(
          address_.raw()->sa_family, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, IPPROTO_TCP))
{
    require(descriptor_, address_);
    try {
        const int yes = 1;
        // What an earlier server has left of its connections is no obstacle.
        require(::setsockopt(descriptor_, SOL_SOCKET, SO_REUSEADDR, &yes, sizeof yes), address_);
        if (address_.isIpv6())
            require(
                ::setsockopt(descriptor_, IPPROTO_IPV6, IPV6_V6ONLY, &yes, sizeof yes), address_);
        require(::bind(descriptor_, address_.raw(), address_.size()), address_);
        require(::listen(descriptor_, SOMAXCONN), address_);
    } catch (...) {
        close();
        throw;
    }
    address_ = actualAddress(descriptor_);
}

ListeningSocket::ListeningSocket(ListeningSocket&& other) noexcept
    : address_(other.address_), isEncrypted_(other.isEncrypted_),
      descriptor_(std::exchange(other.descriptor_, -1))
{
}

void ListeningSocket::refuse()
{
    ::shutdown(descriptor_, SHUT_RDWR);
}

void ListeningSocket::close()
{
    if (descriptor_ >= 0)
        ::close(std::exchange(descriptor_, -1));
}

std::vector<ListeningSocket> listenOn(std::vector<Endpoint> endpoints)
{
    std::vector<ListeningSocket> sockets;
    std::map<bool, std::uint16_t> chosenPorts; // by whether it is encrypted
    for (Endpoint& endpoint : endpoints) {
        const bool isAnyPort = endpoint.address.port() == 0;
        if (isAnyPort)
            endpoint.address.setPort(chosenPorts[endpoint.isEncrypted]);
        try {
            sockets.emplace_back(endpoint);
        } catch (const std::system_error& error) {
            if (endpoint.isOptional && isMissingAddress(error.code())) {
                report(
                    {"listenOn", "ListeningSocket", __LINE__}, error.what(), Severity::information);
                continue;
            }
            if (!isAnyPort || error.code() != std::errc::address_in_use)
                throw;
            endpoint.address.setPort(0);
            sockets.emplace_back(endpoint);
        }
        chosenPorts[endpoint.isEncrypted] = sockets.back().address().port();
    }
    return sockets;
}

} // namespace Host::Http
