// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/ListenPolicy.h"

#include <vector>

namespace Host::Http {

// A socket on which clients can connect from its construction on; they wait until somebody
// accepts them.
class ListeningSocket {
public:
    // Throws std::runtime_error naming the address and the reason, std::system_error with the
    // error's code among them.
    explicit ListeningSocket(const Endpoint& endpoint);
    ~ListeningSocket() { close(); }
    ListeningSocket(ListeningSocket&& other) noexcept;
    ListeningSocket& operator=(ListeningSocket&&) = delete;

    // With the actual port where any was wished for.
    const Address& address() const { return address_; }
    bool isEncrypted() const { return isEncrypted_; }
    int descriptor() const { return descriptor_; }

    // Nobody can connect any more; the descriptor stays valid. Idempotent.
    void refuse();

    // Idempotent.
    void close();

private:
    Address address_;
    bool isEncrypted_;
    int descriptor_;
};

// Listens on all of them; an optional one that this machine does not have is left out and told to
// the log. Where any port will do, the addresses share one if they can.
std::vector<ListeningSocket> listenOn(std::vector<Endpoint> endpoints);

} // namespace Host::Http
