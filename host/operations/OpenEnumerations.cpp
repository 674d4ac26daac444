// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/OpenEnumerations.h"

#include "host/broker/Refusal.h"
#include "host/operations/StatusCodes.h"

#include <sys/random.h>

#include <array>
#include <cstdint>
#include <utility>

namespace Host {

namespace {

// 128 random bits as hexadecimal digits.
std::string makeContext()
{
    std::array<std::uint8_t, 16> bytes{};
    // So few bytes come at once or not at all.
    if (::getrandom(bytes.data(), bytes.size(), 0) != static_cast<ssize_t>(bytes.size()))
        throw Refusal(CMPI_RC_ERR_FAILED, "the system has no random numbers");
    constexpr std::string_view digits = "0123456789abcdef";
    std::string context;
    for (const std::uint8_t byte : bytes) {
        context += digits[byte >> 4U];
        context += digits[byte & 15U];
    }
    return context;
}

[[noreturn]] void refuseContext()
{
    throw Refusal(invalidEnumerationContext,
        "no such enumeration is open: it was pulled to its end, closed, or not used for too long");
}

} // namespace

OpenEnumerations::OpenEnumerations(const OperationLimits& limits, Clock clock)
    : limits_(limits), clock_(std::move(clock))
{
}

std::string OpenEnumerations::open(OpenEnumeration enumeration)
{
    std::string context = makeContext();
    const std::size_t held = enumeration.waiting.heldObjects();
    Removed removed; // destroyed without the lock, since much may be freed
    const std::lock_guard lock(mutex_);
    removeExpired(removed);
    if (table_.size() >= limits_.maximumOpenEnumerations)
        throw Refusal(CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED,
            "there are " + std::to_string(table_.size()) + " open enumerations already");
    if (held > limits_.maximumHeldObjects - heldObjects_)
        throw Refusal(CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED,
            "open enumerations would hold more than " + std::to_string(limits_.maximumHeldObjects) +
                " objects");
    const Time end = clock_() + enumeration.timeout;
    table_.emplace(context, Entry{std::move(enumeration), end});
    heldObjects_ += held;
    return context;
}

OpenEnumerations::Pulled OpenEnumerations::pull(
    const std::string& context, const EnumerationOwner& owner, std::size_t count)
{
    Removed removed;
    const std::lock_guard lock(mutex_);
    removeExpired(removed);
    const auto found = table_.find(context);
    if (found == table_.end() || found->second.enumeration.owner != owner)
        refuseContext();
    OpenEnumeration& enumeration = found->second.enumeration;
    Pulled pulled{{}, enumeration.selection};
    pulled.objects = enumeration.waiting.takeFirst(count);
    pulled.isOver = enumeration.waiting.size() == 0;
    found->second.end = clock_() + enumeration.timeout;
    if (pulled.isOver)
        remove(found, removed);
    return pulled;
}

void OpenEnumerations::close(const std::string& context, const EnumerationOwner& owner)
{
    Removed removed;
    const std::lock_guard lock(mutex_);
    removeExpired(removed);
    const auto found = table_.find(context);
    if (found == table_.end() || found->second.enumeration.owner.principal != owner.principal ||
        found->second.enumeration.owner.nameSpace != owner.nameSpace)
        refuseContext();
    remove(found, removed);
}

void OpenEnumerations::removeExpired()
{
    Removed removed;
    const std::lock_guard lock(mutex_);
    removeExpired(removed);
}

void OpenEnumerations::removeExpired(Removed& removed)
{
    const Time now = clock_();
    for (auto entry = table_.begin(); entry != table_.end();) {
        const auto next = std::next(entry);
        if (entry->second.end <= now)
            remove(entry, removed);
        entry = next;
    }
}

void OpenEnumerations::remove(Table::iterator entry, Removed& removed)
{
    const std::size_t held = entry->second.enumeration.waiting.heldObjects();
    removed.emplace_back(); // first: what allocates must not throw after the extraction
    removed.back() = table_.extract(entry);
    heldObjects_ -= held;
}

} // namespace Host
