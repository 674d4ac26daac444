// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Enumerations that clients have opened and pull bit by bit.

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

// Whom an enumeration belongs to and what can be pulled from it. Nobody else gets anything, nor
// learns that it is there.
struct EnumerationOwner {
    std::string principal;
    std::string nameSpace;
    bool pullsPaths = false;

    bool operator==(const EnumerationOwner&) const = default;
};

struct OpenEnumeration {
    EnumerationOwner owner;
    FoundObjects waiting;
    CimXml::ObjectSelection selection; // for what is pulled
    std::chrono::seconds timeout{};    // from one operation on it to the next
};

// May be used from any thread. Operations on one enumeration come one after another; what they
// hand out is read without the lock.
//
// Enumerations whose time is over are never found again, but their memory is given back only with
// the next call, whichever it is: where no client comes any more, the last ones stay, within the
// limits.
class OpenEnumerations {
public:
    using Clock = std::function<std::chrono::steady_clock::time_point()>;

    explicit OpenEnumerations(
        const OperationLimits& limits, Clock clock = std::chrono::steady_clock::now);

    // Returns the context by which clients know it: nobody can guess it. Throws Refusal:
    // CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED where it would be one too many or hold too much,
    // CMPI_RC_ERR_FAILED when the system has no random numbers.
    std::string open(OpenEnumeration enumeration);

    struct Pulled {
        FoundObjects objects;
        CimXml::ObjectSelection selection;
        bool isOver = false; // nothing is left; the enumeration is closed
    };

    // So many of the objects that wait. Its time begins anew. Throw Refusal
    // (invalidEnumerationContext) when there is no such enumeration of this owner.
    Pulled pull(const std::string& context, const EnumerationOwner& owner, std::size_t count);
    // Whatever the owner pulls.
    void close(const std::string& context, const EnumerationOwner& owner);

    // For calls that have to do with none of them.
    void removeExpired();

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
    std::mutex mutex_;
    Table table_;
    std::size_t heldObjects_ = 0;
};

} // namespace Host
