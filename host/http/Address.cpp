// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Address.h"

#include <arpa/inet.h>
#include <netdb.h>

#include <algorithm>
#include <array>
#include <cstring>
#include <memory>
#include <stdexcept>

namespace Host::Http {

Address::Address(const std::string& host, std::uint16_t port)
{
    ::addrinfo hints{};
    hints.ai_flags = AI_NUMERICHOST;
    hints.ai_socktype = SOCK_STREAM;
    ::addrinfo* found = nullptr;
    if (::getaddrinfo(host.c_str(), nullptr, &hints, &found) != 0)
        throw std::invalid_argument("\"" + host + "\" is no IPv4 or IPv6 address");
    const std::unique_ptr<::addrinfo, void (*)(::addrinfo*)> owner(found, ::freeaddrinfo);
    *this = Address(found->ai_addr);
    setPort(port);
}

Address::Address(const ::sockaddr* raw)
{
    std::get<::sockaddr_in>(address_).sin_family = AF_INET;
    if (raw != nullptr && raw->sa_family == AF_INET)
        std::memcpy(&std::get<::sockaddr_in>(address_), raw, sizeof(::sockaddr_in));
    if (raw != nullptr && raw->sa_family == AF_INET6)
        std::memcpy(&address_.emplace<::sockaddr_in6>(), raw, sizeof(::sockaddr_in6));
}

bool Address::isLoopback() const
{
    if (const auto* const ipv6 = std::get_if<::sockaddr_in6>(&address_))
        return IN6_IS_ADDR_LOOPBACK(&ipv6->sin6_addr);
    return ntohl(std::get<::sockaddr_in>(address_).sin_addr.s_addr) >> 24 == IN_LOOPBACKNET;
}

bool Address::isAny() const
{
    if (const auto* const ipv6 = std::get_if<::sockaddr_in6>(&address_))
        return IN6_IS_ADDR_UNSPECIFIED(&ipv6->sin6_addr);
    return std::get<::sockaddr_in>(address_).sin_addr.s_addr == INADDR_ANY;
}

std::uint16_t Address::port() const
{
    const auto* const ipv6 = std::get_if<::sockaddr_in6>(&address_);
    return ntohs(ipv6 ? ipv6->sin6_port : std::get<::sockaddr_in>(address_).sin_port);
}

void Address::setPort(std::uint16_t port)
{
    auto* const ipv6 = std::get_if<::sockaddr_in6>(&address_);
    (ipv6 ? ipv6->sin6_port : std::get<::sockaddr_in>(address_).sin_port) = htons(port);
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
    const std::string text = isIpv6() ? "[" + host() + "]" : host();
    return text + ":" + std::to_string(port());
}

std::string Address::network() const
{
    if (!isIpv6() || isLoopback())
        return host();
    constexpr std::size_t bytesOfNetwork = 8;
    Address prefix = *this;
    auto& bytes = std::get<::sockaddr_in6>(prefix.address_).sin6_addr.s6_addr;
    std::fill(bytes + bytesOfNetwork, bytes + sizeof bytes, std::uint8_t{0});
    return prefix.host() + "/64";
}

const ::sockaddr* Address::raw() const
{
    return std::visit(
        [](const auto& each) { return reinterpret_cast<const ::sockaddr*>(&each); }, address_);
}

::socklen_t Address::size() const
{
    return isIpv6() ? sizeof(::sockaddr_in6) : sizeof(::sockaddr_in);
}

} // namespace Host::Http
