// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Connections.h"

#include "host/http/Address.h"
#include "host/http/EventLog.h"
#include "host/http/Timer.h"

#include <sys/socket.h>

#include <algorithm>
#include <utility>

namespace Host::Http {

namespace {

constexpr std::chrono::milliseconds watchInterval{500};
constexpr std::chrono::seconds complaintInterval{60};
constexpr std::chrono::seconds lastPatience{2}; // with a request that comes in at the end

// Whether the client will send no more, and all it sent was read.
bool hasFallenSilent(int descriptor)
{
    char next = 0;
    return ::recv(descriptor, &next, 1, MSG_PEEK | MSG_DONTWAIT) == 0;
}

} // namespace

ClientConnection* Connections::add(
    int descriptor, const Address& client, std::shared_ptr<const Certificate> certificate)
{
    const std::lock_guard lock(mutex_);
    const std::string neighbourhood = client.neighbourhood();
    if (!hasRoomFor(client, neighbourhood)) {
        ::shutdown(descriptor, SHUT_RDWR);
        return nullptr;
    }
    ClientConnection& connection = all_.emplace_back(descriptor, client, std::move(certificate));
    try {
        ++countByNeighbourhood_[neighbourhood];
    } catch (...) {
        all_.pop_back();
        throw;
    }
    // Its first request may begin late, but not last for ever without becoming one.
    connection.deadline = Clock::now() + patienceIn(Phase::idle);
    if (isWindingUp_)
        ::shutdown(descriptor, SHUT_RD);
    watch();
    return &connection;
}

bool Connections::hasRoomFor(const Address& client, const std::string& neighbourhood)
{
    const auto found = countByNeighbourhood_.find(neighbourhood);
    const bool areTooMany = all_.size() >= limits_.maximumConnections;
    const bool areTooManyThere = found != countByNeighbourhood_.end() &&
                                 found->second >= limits_.maximumConnectionsPerAddress;
    if (areTooMany || areTooManyThere)
        complain(client, areTooMany);
    return !areTooMany && !areTooManyThere;
}

void Connections::complain(const Address& client, bool areTooMany)
{
    const auto now = Clock::now();
    if (lastComplaint_ != Clock::time_point{} && now - lastComplaint_ < complaintInterval)
        return;
    lastComplaint_ = now;
    report({"complain", "Connections", __LINE__},
        "refused a connection from " + client.host() + ": there are " +
            std::to_string(all_.size()) +
            (areTooMany ? "" : ", too many of them from this address"));
}

void Connections::remove(ClientConnection& connection)
{
    // Ends outside the lock, with whatever it holds.
    std::list<ClientConnection> removed;
    {
        const std::lock_guard lock(mutex_);
        if (connection.phase != Phase::idle)
            --busy_;
        const auto count = countByNeighbourhood_.find(connection.neighbourhood);
        if (--count->second == 0)
            countByNeighbourhood_.erase(count);
        const auto place = std::find_if(all_.begin(), all_.end(),
            [&](const ClientConnection& each) { return &each == &connection; });
        removed.splice(removed.end(), all_, place);
    }
    changed_.notify_all();
}

void Connections::enter(ClientConnection& connection, Phase phase)
{
    bool hasEnded = false;
    {
        const std::lock_guard lock(mutex_);
        if (connection.phase == Phase::idle && phase != Phase::idle)
            ++busy_;
        if (connection.phase != Phase::idle && phase == Phase::idle) {
            --busy_;
            hasEnded = true;
        }
        if (phase == Phase::idle && isWindingUp_)
            ::shutdown(connection.descriptor, SHUT_RD);
        connection.phase = phase;
        connection.deadline = Clock::now() + patienceIn(phase);
    }
    if (hasEnded)
        changed_.notify_all();
}

std::chrono::seconds Connections::patienceIn(Phase phase) const
{
    switch (phase) {
    case Phase::receiving:
        return isWindingUp_ ? std::min(limits_.requestTimeout, lastPatience)
                            : limits_.requestTimeout;
    case Phase::answering:
        return limits_.answerTimeout;
    default:
        return limits_.idleTimeout + limits_.requestTimeout;
    }
}

bool Connections::mayFallAsleep()
{
    const std::lock_guard lock(mutex_);
    if (isAwake_)
        return false;
    ++asleep_;
    return true;
}

void Connections::awake()
{
    {
        const std::lock_guard lock(mutex_);
        --asleep_;
    }
    changed_.notify_all();
}

void Connections::windUp()
{
    const std::lock_guard lock(mutex_);
    isWindingUp_ = true;
    const auto latest = Clock::now() + patienceIn(Phase::receiving);
    for (ClientConnection& connection : all_) {
        if (connection.phase == Phase::idle)
            ::shutdown(connection.descriptor, SHUT_RD);
        if (connection.phase == Phase::receiving)
            connection.deadline = std::min(connection.deadline, latest);
    }
}

bool Connections::isWindingUp() const
{
    const std::lock_guard lock(mutex_);
    return isWindingUp_;
}

bool Connections::waitUntilQuiet(std::chrono::milliseconds patience)
{
    std::unique_lock lock(mutex_);
    return changed_.wait_for(lock, patience, [this] { return busy_ == 0; });
}

void Connections::stopWatching()
{
    const std::lock_guard lock(mutex_);
    isWatchOver_ = true;
}

void Connections::waitUntilAllAreAwake()
{
    std::unique_lock lock(mutex_);
    isAwake_ = true;
    changed_.wait(lock, [this] { return asleep_ == 0; });
}

void Connections::watch()
{
    if (isWatching_ || isWatchOver_ || all_.empty())
        return;
    try {
        timer_.at(Clock::now() + watchInterval, [this] { closeOverdue(); });
        isWatching_ = true;
    } catch (...) {
        return; // the next connection tries again
    }
}

void Connections::closeOverdue()
{
    const std::lock_guard lock(mutex_);
    isWatching_ = false;
    watch(); // first: what follows may run out of memory
    const auto now = Clock::now();
    for (const ClientConnection& connection : all_) {
        if (connection.phase == Phase::working)
            continue;
        // The library does not notice an end that comes together with the last bytes.
        if (connection.phase != Phase::answering && hasFallenSilent(connection.descriptor))
            ::shutdown(connection.descriptor, SHUT_RD);
        if (now < connection.deadline)
            continue;
        ::shutdown(connection.descriptor, SHUT_RDWR);
        mention({"closeOverdue", "Connections", __LINE__},
            "a client at " + connection.address + " is too slow");
    }
}

} // namespace Host::Http
