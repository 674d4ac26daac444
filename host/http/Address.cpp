// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Address.h"

#include <arpa/inet.h>
#include <netdb.h>
#include <netinet/in.h>

#include <algorithm>
#include <array>
#include <cstring>
#include <memory>
#include <stdexcept>

namespace Host::Http {

namespace {

// What the storage holds is what it was copied from.
::sockaddr_in ipv4(const ::sockaddr_storage& storage)
{
    ::sockaddr_in address{};
    std::memcpy(&address, &storage, sizeof address);
    return address;
}

::sockaddr_in6 ipv6(const ::sockaddr_storage& storage)
{
    ::sockaddr_in6 address{};
    std::memcpy(&address, &storage, sizeof address);
    return address;
}

bool isSame(const ::in6_addr& one, const ::in6_addr& other)
{
    return std::memcmp(&one, &other, sizeof one) == 0;
}

constexpr std::uint32_t loopbackNetwork = 127; // 127.0.0.0/8

} // namespace

Address::Address(const std::string& host, std::uint16_t port)
{
    ::addrinfo hints{};
    hints.ai_flags = AI_NUMERICHOST;
    hints.ai_socktype = SOCK_STREAM;
    ::addrinfo* found = nullptr;
    if (::getaddrinfo(host.c_str(), nullptr, &hints, &found) != 0)
        throw std::invalid_argument("\"" + host + "\" is no IPv4 or IPv6 address");
    const std::unique_ptr<::addrinfo, void (*)(::addrinfo*)> owner(found, ::freeaddrinfo);
    std::memcpy(
        &storage_, found->ai_addr, std::min<std::size_t>(found->ai_addrlen, sizeof storage_));
    setPort(port);
}

Address::Address(const ::sockaddr* raw)
{
    storage_.ss_family = AF_INET;
    if (raw == nullptr)
        return;
    if (raw->sa_family == AF_INET)
        std::memcpy(&storage_, raw, sizeof(::sockaddr_in));
    if (raw->sa_family == AF_INET6)
        std::memcpy(&storage_, raw, sizeof(::sockaddr_in6));
}

bool Address::isLoopback() const
{
    if (isIpv6())
        return isSame(ipv6(storage_).sin6_addr, ::in6addr_loopback);
    return ntohl(ipv4(storage_).sin_addr.s_addr) >> 24 == loopbackNetwork;
}

bool Address::isAny() const
{
    if (isIpv6())
        return isSame(ipv6(storage_).sin6_addr, ::in6addr_any);
    return ipv4(storage_).sin_addr.s_addr == htonl(INADDR_ANY);
}

std::uint16_t Address::port() const
{
    return ntohs(isIpv6() ? ipv6(storage_).sin6_port : ipv4(storage_).sin_port);
}

void Address::setPort(std::uint16_t port)
{
    if (isIpv6()) {
        ::sockaddr_in6 changed = ipv6(storage_);
        changed.sin6_port = htons(port);
        std::memcpy(&storage_, &changed, sizeof changed);
    } else {
        ::sockaddr_in changed = ipv4(storage_);
        changed.sin_port = htons(port);
        std::memcpy(&storage_, &changed, sizeof changed);
    }
}

std::string Address::host() const
{
    std::array<char, NI_MAXHOST> text{};
    if (::getnameinfo(raw(), size(), text.data(), text.size(), nullptr, 0, NI_NUMERICHOST) != 0)
        return "?";
    return text.data();
}

std::string Address::text() const
{
    std::string text = host();
    if (isIpv6())
        text = std::string("[").append(text).append("]");
    return text.append(":").append(std::to_string(port()));
}

std::string Address::neighbourhood() const
{
    if (!isIpv6() || isLoopback())
        return host();
    constexpr std::size_t bytesOfNetwork = 8;
    ::sockaddr_in6 network = ipv6(storage_);
    auto& bytes = network.sin6_addr.s6_addr;
    std::fill(bytes + bytesOfNetwork, bytes + sizeof bytes, std::uint8_t{0});
    return Address(reinterpret_cast<const ::sockaddr*>(&network)).host() + "/64";
}

::socklen_t Address::size() const
{
    return isIpv6() ? sizeof(::sockaddr_in6) : sizeof(::sockaddr_in);
}

} // namespace Host::Http
