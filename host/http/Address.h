// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <sys/socket.h>

#include <cstdint>
#include <string>

namespace Host::Http {

// An IPv4 or IPv6 address with a port.
class Address {
public:
    // Throws std::invalid_argument for what is neither, such as the name of a host.
    Address(const std::string& host, std::uint16_t port);
    // Anything else becomes 0.0.0.0.
    explicit Address(const ::sockaddr* raw);

    // Whether only this machine itself can reach it.
    bool isLoopback() const;
    bool isAny() const; // 0.0.0.0 or ::
    bool isIpv6() const { return storage_.ss_family == AF_INET6; }
    std::uint16_t port() const;
    void setPort(std::uint16_t port);

    // Such as 127.0.0.1 or ::1.
    std::string host() const;
    // Such as 127.0.0.1:5988 or [::1]:5988.
    std::string text() const;
    // The host, or the network of 64 bits that an IPv6 one can choose its addresses from.
    std::string neighbourhood() const;

    const ::sockaddr* raw() const { return reinterpret_cast<const ::sockaddr*>(&storage_); }
    ::socklen_t size() const;

private:
    ::sockaddr_storage storage_{};
};

} // namespace Host::Http
