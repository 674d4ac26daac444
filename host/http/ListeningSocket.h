// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/ListenPolicy.h"

#include <vector>

namespace Host::Http {

// A socket that listens from its construction on. The system queues clients until they are
// accepted.
class ListeningSocket {
public:
    // Throws std::system_error with the address and the reason.
    explicit ListeningSocket(const Endpoint& endpoint);
    ~ListeningSocket() { close(); }
    ListeningSocket(ListeningSocket&& other) noexcept;
    ListeningSocket& operator=(ListeningSocket&&) = delete;

    // Returns the address with its actual port.
    const Address& address() const { return address_; }
    bool isEncrypted() const { return isEncrypted_; }
    int descriptor() const { return descriptor_; }

    // Refuses further clients. The descriptor stays valid. Idempotent.
    void refuse();

private:
    void close();

    Address address_;
    bool isEncrypted_;
    int descriptor_;
};

// Listens on all endpoints. An optional one that the machine does not have is left out and reported
// to the log. Addresses whose port is 0 share one free port where they can.
std::vector<ListeningSocket> listenOn(std::vector<Endpoint> endpoints);

} // namespace Host::Http
