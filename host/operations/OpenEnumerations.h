// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The enumerations that clients have opened and pull from (DSP0200).

#pragma once

#include "host/cimxml/ObjectSelection.h"
#include "host/operations/FoundObjects.h"
#include "host/operations/OperationLimits.h"

#include <chrono>
#include <functional>
#include <mutex>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Host {

// The client that opened an enumeration, and what it pulls. For others the enumeration does not
// exist.
struct EnumerationOwner {
    std::string principal;
    std::string nameSpace;
    bool pullsPaths = false;

    bool operator==(const EnumerationOwner&) const = default;
};

struct OpenEnumeration {
    EnumerationOwner owner;
    FoundObjects waiting;
    CimXml::ObjectSelection selection; // for the objects that are pulled
    std::chrono::seconds timeout{};    // between two operations on it
};

// Thread-safe. The objects that are pulled are read without the lock.
//
// Enumerations that have timed out are never found again, but their memory is freed only with the
// next call: where no client calls any more, the last ones stay, within the limits.
class OpenEnumerations {
public:
    using Clock = std::function<std::chrono::steady_clock::time_point()>;

    explicit OpenEnumerations(
        const OperationLimits& limits, Clock clock = std::chrono::steady_clock::now);

    // Returns the enumeration context, which cannot be guessed. Throws Refusal:
    // CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED for one enumeration or object too many,
    // CMPI_RC_ERR_FAILED when the system has no random numbers.
    std::string open(OpenEnumeration enumeration);

    struct Pulled {
        FoundObjects objects;
        CimXml::ObjectSelection selection;
        bool isOver = false; // nothing is left; the enumeration is closed
    };

    // Returns at most that many of the remaining objects and restarts the timeout. Throws Refusal
    // (invalidEnumerationContext) when the owner has no such enumeration.
    Pulled pull(const std::string& context, const EnumerationOwner& owner, std::size_t count);
    // Closes the enumeration, whatever the owner pulls. Throws as pull() does.
    void close(const std::string& context, const EnumerationOwner& owner);

    // Frees enumerations that have timed out. Operations that use none call it.
    void removeExpired();

    // Returns the number of objects in memory.
    std::size_t heldObjects() const
    {
        const std::lock_guard lock(mutex_);
        return heldObjects_;
    }

private:
    using Time = std::chrono::steady_clock::time_point;
    struct Entry {
        OpenEnumeration enumeration;
        Time end;
    };
    using Table = std::unordered_map<std::string, Entry>;
    using Removed = std::vector<Table::node_type>;

    void removeExpired(Removed& removed);
    void remove(Table::iterator entry, Removed& removed);

    const OperationLimits limits_;
    const Clock clock_;
    mutable std::mutex mutex_;
    Table table_;
    std::size_t heldObjects_ = 0;
};

} // namespace Host
