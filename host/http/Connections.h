// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Everybody who is connected: how many, and for how long they may be still or slow.

#pragma once

#include "host/http/ClientConnection.h"
#include "host/http/Limits.h"

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <list>
#include <map>
#include <mutex>
#include <string>

namespace Host::Http {

class Address;
class Timer;

// Thread-safe. The timer must have ended before this object goes.
class Connections {
public:
    Connections(const Limits& limits, Timer& timer) : limits_(limits), timer_(timer) {}

    // Null where that would be one too many, or one too many at its address: the connection ends,
    // which goes to the log now and then.
    ClientConnection* add(
        int descriptor, const Address& client, std::shared_ptr<const Certificate> certificate);
    // The exchange must have ended.
    void remove(ClientConnection& connection);

    void enter(ClientConnection& connection, Phase phase);

    // To be asked before a connection is put to sleep; false when there is no time for that any
    // more. Pairs with awake().
    bool mayFallAsleep();
    void awake();

    // From now on no connection is kept for a further request; those without one end now, the
    // others with theirs, or soon where it does not come in.
    void windUp();
    bool isWindingUp() const;
    // Waits until no request is at work, at most so long; whether that is so then.
    bool waitUntilQuiet(std::chrono::milliseconds patience);
    // Nobody is too slow any more. To be called before the timer ends.
    void stopWatching();
    // No connection may fall asleep any more. Returns when all have woken up.
    void waitUntilAllAreAwake();

private:
    using Clock = std::chrono::steady_clock;

    void closeOverdue();

    // REQUIRES: the mutex is held.
    std::chrono::seconds patienceIn(Phase phase) const;
    bool hasRoomFor(const Address& client, const std::string& neighbourhood);
    void complain(const Address& client, bool areTooMany);
    void watch();

    const Limits& limits_;
    Timer& timer_;
    mutable std::mutex mutex_;
    std::condition_variable changed_;
    std::list<ClientConnection> all_;
    std::map<std::string, std::size_t> countByNeighbourhood_;
    std::size_t busy_ = 0;   // connections that are not idle
    std::size_t asleep_ = 0; // connections whose thread of service waits for somebody to wake them
    bool isWatching_ = false;
    bool isWatchOver_ = false;
    bool isWindingUp_ = false;
    bool isAwake_ = false; // for good
    Clock::time_point lastComplaint_{};
};

} // namespace Host::Http
