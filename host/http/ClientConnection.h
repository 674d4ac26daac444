// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Address.h"
#include "host/http/Certificate.h"
#include "host/http/Exchange.h"

#include <chrono>
#include <memory>
#include <optional>
#include <string>
#include <utility>

namespace Host::Http {

enum class Phase {
    idle,      // between requests
    receiving, // a request comes in
    working,   // it is carried out; the client cannot be late
    answering, // the client fetches the answer
};

// A client that is connected, from then to the end. Belongs to Connections.
struct ClientConnection {
    ClientConnection(
        int socket, const Address& client, std::shared_ptr<const Certificate> shownCertificate)
        : descriptor(socket), address(client.host()), neighbourhood(client.neighbourhood()),
          certificate(std::move(shownCertificate))
    {
    }

    const int descriptor;
    const std::string address;                            // for the log
    const std::string neighbourhood;                      // for what one address may take
    const std::shared_ptr<const Certificate> certificate; // null without TLS

    // Of Connections, which guards them.
    Phase phase = Phase::idle;
    std::chrono::steady_clock::time_point deadline{};

    // Of the thread that serves the connection.
    std::string target; // of the request that comes in
    std::optional<Exchange> exchange;
};

} // namespace Host::Http
