// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <netinet/in.h>
#include <sys/socket.h>

#include <cstdint>
#include <string>
#include <variant>

namespace Host::Http {

// An IPv4 or IPv6 address with a port.
class Address {
public:
    // Throws std::invalid_argument for a host that is neither, such as a name.
    Address(const std::string& host, std::uint16_t port);
    // Copies an address of either family; any other becomes 0.0.0.0.
    explicit Address(const ::sockaddr* raw);

    bool isLoopback() const; // 127.0.0.0/8 or ::1
    bool isAny() const;      // 0.0.0.0 or ::
    bool isIpv6() const { return std::holds_alternative<::sockaddr_in6>(address_); }
    std::uint16_t port() const;
    void setPort(std::uint16_t port);

    // Returns a text such as 127.0.0.1 or ::1.
    std::string host() const;
    // Returns a text such as 127.0.0.1:5988 or [::1]:5988.
    std::string text() const;
    // Returns the network to which limits for an address apply: the host of an IPv4 address, and
    // the 64-bit network of an IPv6 address, since an IPv6 host can use any address in its network.
    std::string network() const;

    const ::sockaddr* raw() const;
    ::socklen_t size() const;

private:
    std::variant<::sockaddr_in, ::sockaddr_in6> address_;
};

} // namespace Host::Http
