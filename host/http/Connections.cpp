// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Connections.h"

#include "host/http/Address.h"
#include "host/http/EventLog.h"
#include "host/http/Resource.h"

#include <poll.h>
#include <sys/socket.h>

#include <algorithm>
#include <new>
#include <tuple>
#include <utility>

namespace Host::Http {

namespace {

constexpr std::chrono::milliseconds watchInterval{500};
constexpr std::chrono::seconds requestTimeoutInShutdown{2};

// Returns whether the client has closed its direction and all that it sent was read.
bool hasClientFinished(int descriptor)
{
    char next = 0;
    return ::recv(descriptor, &next, 1, MSG_PEEK | MSG_DONTWAIT) == 0;
}

// For this time, new connections are closed after all others, since their clients may be sending
// the first request or may be in a TLS handshake. Most requests arrive within it.
constexpr std::chrono::seconds timeToSend{2};

// Returns whether the client has sent what the thread of the connection has yet to read.
bool hasUnreadBytes(int descriptor)
{
    char next = 0;
    return ::recv(descriptor, &next, 1, MSG_PEEK | MSG_DONTWAIT) > 0;
}

// Returns whether the client has closed the connection or its direction, even where some of what it
// sent was not read.
bool hasClientClosed(int descriptor)
{
    ::pollfd state{descriptor, POLLRDHUP, 0};
    return ::poll(&state, 1, 0) == 1;
}

} // namespace

Connections::Connections(const Limits& limits)
    : limits_(limits), watcher_([this](const std::stop_token& stop) { watch(stop); })
{
}

ClientConnection* Connections::add(
    int descriptor, const Address& client, std::shared_ptr<const Certificate> certificate)
{
    std::unique_lock lock(mutex_);
    // An address with too many makes room among its own.
    const bool isRoomForAddress =
        makeRoomAmong([network = client.network()](
                          const ClientConnection& each) { return each.network == network; },
            limits_.maximumConnectionsPerAddress);
    const bool isRoom =
        isRoomForAddress &&
        makeRoomAmong([](const ClientConnection&) { return true; }, limits_.maximumConnections);
    if (!isRoom) {
        const std::size_t count = all_.size();
        ::shutdown(descriptor, SHUT_RDWR);
        lock.unlock();
        if (refusals_.allowsReport())
            report({"add", "Connections", __LINE__},
                "refused a connection from " + client.host() + ": there are " +
                    std::to_string(count) +
                    (isRoomForAddress ? "" : ", too many of them from this address"));
        return nullptr;
    }
    ClientConnection& connection = all_.emplace_back(descriptor, client, std::move(certificate));
    // Bounds the handshake and the wait for the first request.
    connection.deadline = Clock::now() + timeoutOf(Phase::idle);
    if (isShuttingDown_)
        ::shutdown(descriptor, SHUT_RD);
    if (all_.size() == 1)
        changed_.notify_all();
    return &connection;
}

template <typename Counts>
bool Connections::makeRoomAmong(const Counts& counts, std::size_t maximum)
{
    std::vector<ClientConnection*> counted;
    for (ClientConnection& each : all_)
        if (!each.isLeaving && counts(each))
            counted.push_back(&each);
    if (counted.size() < maximum)
        return true;
    const auto hadTime = [&, now = Clock::now()](const ClientConnection* each) {
        const auto begin = each->deadline - timeoutOf(each->phase);
        return begin + timeToSend < now;
    };
    const auto mayClose = [&](const ClientConnection* each) {
        const bool isSlow = each->phase == Phase::receiving && hadTime(each);
        return (each->phase == Phase::idle || isSlow) && !hasUnreadBytes(each->descriptor);
    };
    std::erase_if(counted, [&](const ClientConnection* each) { return !mayClose(each); });
    const auto rank = [&](const ClientConnection* each) {
        const bool isSlow = each->phase == Phase::receiving;
        const bool isNew = each->use == Use::nothing && !hadTime(each);
        return std::tuple(isNew, isSlow, isSlow ? Use::nothing : each->use, each->deadline);
    };
    const auto found = std::ranges::min_element(counted, {}, rank);
    if (found == counted.end())
        return false;
    (*found)->isLeaving = true;
    ::shutdown((*found)->descriptor, SHUT_RDWR);
    return true;
}

void Connections::remove(ClientConnection& connection)
{
    // The connection is destroyed, with all that it holds, when the mutex is free again.
    std::list<ClientConnection> removed;
    enter(connection, Phase::idle);
    const std::lock_guard lock(mutex_);
    const auto place = std::find_if(all_.begin(), all_.end(),
        [&](const ClientConnection& each) { return &each == &connection; });
    removed.splice(removed.end(), all_, place);
    if (all_.empty())
        becameIdle_.notify_all();
}

void Connections::enter(ClientConnection& connection, Phase phase)
{
    const std::lock_guard lock(mutex_);
    if (connection.phase == Phase::idle && phase != Phase::idle)
        ++busy_;
    if (connection.phase != Phase::idle && phase == Phase::idle && --busy_ == 0)
        becameIdle_.notify_all();
    if (phase == Phase::idle && isShuttingDown_)
        ::shutdown(connection.descriptor, SHUT_RD);
    connection.phase = phase;
    if (phase == Phase::fetching)
        connection.use = Use::resources;
    else if (phase != Phase::idle && connection.use == Use::nothing)
        connection.use = Use::operations;
    const bool isLastPiece = isShuttingDown_ && connection.stream != nullptr;
    connection.deadline = Clock::now() + timeoutOf(isLastPiece ? Phase::receiving : phase);
}

bool Connections::beginStream(ClientConnection& connection, Stream& stream)
{
    const std::lock_guard lock(mutex_);
    if (isShuttingDown_ || exceedsLimitsOfStreams(connection))
        return false;
    connection.stream = &stream;
    return true;
}

bool Connections::exceedsLimitsOfStreams(const ClientConnection& connection) const
{
    std::size_t all = 0;
    std::size_t ofNetwork = 0;
    for (const ClientConnection& each : all_) {
        all += each.stream != nullptr ? 1 : 0;
        ofNetwork += each.stream != nullptr && each.network == connection.network ? 1 : 0;
    }
    return all >= limits_.maximumConnections / 2 ||
           ofNetwork >= limits_.maximumConnectionsPerAddress / 2;
}

void Connections::endStream(ClientConnection& connection) noexcept
{
    const std::lock_guard lock(mutex_);
    connection.stream = nullptr;
}

void Connections::endStreams()
{
    const std::lock_guard lock(mutex_);
    for (const ClientConnection& connection : all_)
        if (connection.stream != nullptr)
            connection.stream->end();
}

std::chrono::seconds Connections::timeoutOf(Phase phase) const
{
    switch (phase) {
    case Phase::receiving:
        return isShuttingDown_ ? std::min(limits_.requestTimeout, requestTimeoutInShutdown)
                               : limits_.requestTimeout;
    case Phase::answering:
        return limits_.answerTimeout;
    case Phase::fetching:
        return std::min(limits_.answerTimeout, limits_.requestTimeout);
    default:
        return limits_.idleTimeout + limits_.requestTimeout;
    }
}

void Connections::beginShutdown()
{
    const std::lock_guard lock(mutex_);
    isShuttingDown_ = true;
    const auto latest = Clock::now() + timeoutOf(Phase::receiving);
    for (ClientConnection& connection : all_) {
        if (connection.phase == Phase::idle)
            ::shutdown(connection.descriptor, SHUT_RD);
        if (connection.phase == Phase::receiving)
            connection.deadline = std::min(connection.deadline, latest);
        if (connection.stream != nullptr) { // also while the client fetches a piece
            connection.stream->end();
            connection.deadline = std::min(connection.deadline, latest);
        }
    }
    changed_.notify_all();
}

void Connections::closeAll()
{
    std::unique_lock lock(mutex_);
    for (const ClientConnection& connection : all_)
        ::shutdown(connection.descriptor, SHUT_RDWR);
    becameIdle_.wait(lock, [this] { return all_.empty(); });
}

bool Connections::isShuttingDown() const
{
    const std::lock_guard lock(mutex_);
    return isShuttingDown_;
}

bool Connections::waitUntil(ClientConnection& connection, Clock::time_point time)
{
    std::unique_lock lock(mutex_);
    connection.phase = Phase::waiting;
    const bool isInterrupted = changed_.wait_until(
        lock, time, [&] { return isShuttingDown_ || connection.phase != Phase::waiting; });
    connection.phase = Phase::working;
    return !isInterrupted;
}

bool Connections::waitUntilIdle(std::chrono::milliseconds timeout)
{
    std::unique_lock lock(mutex_);
    return becameIdle_.wait_for(lock, timeout, [this] { return busy_ == 0; });
}

void Connections::watch(const std::stop_token& stop)
{
    std::unique_lock lock(mutex_);
    while (changed_.wait(lock, stop, [this] { return !all_.empty(); }) && !stop.stop_requested()) {
        changed_.wait_for(lock, stop, watchInterval, [] { return false; });
        const auto lines = closeOverdue();
        lock.unlock();
        for (const std::string& line : lines)
            reportDetail({"watch", "Connections", __LINE__}, line);
        lock.lock();
    }
}

void Connections::interrupt(ClientConnection& connection)
{
    connection.phase = Phase::working;
    if (connection.stream != nullptr)
        connection.stream->end();
    changed_.notify_all();
}

std::vector<std::string> Connections::closeOverdue()
{
    std::vector<std::string> lines;
    const auto now = Clock::now();
    for (ClientConnection& connection : all_) {
        if (connection.phase == Phase::waiting && hasClientClosed(connection.descriptor)) {
            ::shutdown(connection.descriptor, SHUT_RDWR);
            interrupt(connection);
        }
        if (connection.phase == Phase::working || connection.phase == Phase::waiting)
            continue;
        // libmicrohttpd overlooks an end that arrives together with the last bytes.
        const bool isAnswered =
            connection.phase == Phase::answering || connection.phase == Phase::fetching;
        if (!isAnswered && hasClientFinished(connection.descriptor))
            ::shutdown(connection.descriptor, SHUT_RD);
        if (now < connection.deadline)
            continue;
        ::shutdown(connection.descriptor, SHUT_RDWR);
        try {
            if (areDetailsLogged())
                lines.push_back("a client at " + connection.address + " is too slow");
        } catch (const std::bad_alloc&) {
            continue; // the line is lost, and the others are closed nevertheless
        }
    }
    return lines;
}

} // namespace Host::Http
