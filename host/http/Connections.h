// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Address.h"
#include "host/http/Certificate.h"
#include "host/http/Exchange.h"
#include "host/http/Limits.h"
#include "host/http/ReportInterval.h"

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <list>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <thread>
#include <utility>
#include <vector>

namespace Host::Http {

class Stream;

enum class Phase {
    idle,      // between requests
    receiving, // a request arrives
    working,   // the server works on it: no timeout counts
    waiting,   // its sign-in (see waitUntil) or its stream waits; ends when the client closes the
               // connection
    answering, // the client fetches the answer
    fetching,  // the client fetches a resource or a piece of a stream
};

// What a client has used a connection for. To make room, idle ones are closed in this order.
enum class Use {
    nothing,
    resources,  // as browsers and Prometheus do, which connect again
    operations, // or requests that were refused
};

// An open connection. Connections owns it.
struct ClientConnection {
    ClientConnection(
        int socket, const Address& client, std::shared_ptr<const Certificate> shownCertificate)
        : descriptor(socket), address(client.host()), network(client.network()),
          certificate(std::move(shownCertificate))
    {
    }

    const int descriptor;
    const std::string address;                            // for the log
    const std::string network;                            // for the limits of an address
    const std::shared_ptr<const Certificate> certificate; // null for a server without TLS

    // Guarded by the mutex of Connections.
    Phase phase = Phase::idle;
    std::chrono::steady_clock::time_point deadline{};
    Stream* stream = nullptr; // of the answer
    Use use = Use::nothing;
    bool isLeaving = false; // closed to make room, and no longer counted

    // Used by the connection's thread only.
    std::string target; // of the request that arrives
    std::optional<Exchange> exchange;
};

// The connections of all clients. Bounds their number, and closes those that exceed a timeout from
// a thread of its own. Thread-safe.
class Connections {
public:
    using Clock = std::chrono::steady_clock;

    // The limits must outlive it. Throws std::system_error when the thread cannot be started.
    explicit Connections(const Limits& limits);
    Connections(const Connections&) = delete;
    Connections& operator=(const Connections&) = delete;

    // Returns null where the connection exceeds a limit: it is shut down, and the log says so at
    // most once a minute.
    ClientConnection* add(
        int descriptor, const Address& client, std::shared_ptr<const Certificate> certificate);
    // REQUIRES: the connection's exchange is destroyed.
    void remove(ClientConnection& connection);

    void enter(ClientConnection& connection, Phase phase);

    // The stream is ended when the client closes the connection, and when the shutdown begins.
    // Returns false where half of the connections, or of those of the address, are streams.
    bool beginStream(ClientConnection& connection, Stream& stream);
    void endStream(ClientConnection& connection) noexcept;
    // Ends all streams.
    void endStreams();

    // From now on no connection stays open for a further request. Idle connections are closed now,
    // the others after their answer, or soon when their request does not arrive. Idempotent.
    void beginShutdown();
    bool isShuttingDown() const;
    // Closes all connections, and blocks until they are removed. REQUIRES: the shutdown has begun,
    // and no further connection is accepted.
    void closeAll();
    // Blocks until the time, but no longer than until the shutdown begins or the client closes the
    // connection. Returns whether the time was reached. REQUIRES: the phase is `working`.
    bool waitUntil(ClientConnection& connection, Clock::time_point time);
    // Blocks until no request is in progress, at most for the timeout. Returns whether that was
    // reached.
    bool waitUntilIdle(std::chrono::milliseconds timeout);

private:
    void watch(const std::stop_token& stop);

    // The functions that follow require that the mutex is held. As the log may be slow, none writes
    // to it meanwhile.

    // Returns what is to be logged.
    std::vector<std::string> closeOverdue();
    std::chrono::seconds timeoutOf(Phase phase) const;
    // Returns whether there is room for one more connection of those that count, for which one of
    // them is closed where need be (RFC 9112, 9.5): of the idle ones with the least use the one
    // that has been idle the longest; then one whose request arrives too slowly; new ones last.
    // None is closed that has just begun a request or has sent bytes that were not read yet.
    template <typename Counts>
    bool makeRoomAmong(const Counts& counts, std::size_t maximum);
    bool exceedsLimitsOfStreams(const ClientConnection& connection) const;
    // Ends what the connection waits for.
    void interrupt(ClientConnection& connection);

    const Limits& limits_;
    mutable std::mutex mutex_;
    // Notified when the first connection is added, when a wait is interrupted and when the shutdown
    // begins.
    std::condition_variable_any changed_;
    // Notified when the last request in progress ends and when the last connection is removed. It
    // is a condition of its own, since the watcher, which waits for changed_, would run after each
    // request of a client.
    std::condition_variable becameIdle_;
    std::list<ClientConnection> all_;
    std::size_t busy_ = 0; // connections that are not idle
    bool isShuttingDown_ = false;
    ReportInterval refusals_;
    std::jthread watcher_; // last: it uses all of the above
};

} // namespace Host::Http
