// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <chrono>
#include <cstddef>

namespace Host::Http {

// Bounds on what clients can make the server spend.
struct Limits {
    std::size_t maximumBody = std::size_t{1} << 20;    // bytes of a request
    std::size_t maximumHeader = std::size_t{16} << 10; // bytes of its first line and its fields

    std::size_t maximumDepth = 64; // of nested elements

    std::size_t maximumConnections = 256;
    std::size_t maximumConnectionsPerAddress = 64; // an IPv6 network of 64 bits is one address

    // The number of operations and password checks that run at a time, and of those that wait.
    std::size_t workers = 4;
    std::size_t maximumQueue = 128;

    // The number of objects in all answers that clients have yet to fetch; a single answer may have
    // more. A sensor takes four kilobytes. Objects of operations that still run do not count.
    std::size_t maximumUnsentObjects = 200'000;

    // How long a connection may transfer nothing in either direction, how long a request may take
    // to arrive, and how long the client may take to fetch the answer. It may take no longer to
    // fetch a resource than a request may to arrive.
    std::chrono::seconds idleTimeout{60};
    std::chrono::seconds requestTimeout{30};
    std::chrono::seconds answerTimeout{600};

    // The delay after the first wrong password. It doubles with each further one from the same
    // address, up to 32 times.
    std::chrono::milliseconds signInDelay{1000};
};

} // namespace Host::Http
