// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The operations that open an enumeration, pull from it and close it (DSP0200).

#pragma once

#include "host/cimxml/Operation.h"
#include "host/operations/ObjectResponse.h"
#include "host/operations/OpenEnumerations.h"

#include <string>

namespace Host {

// Thread-safe.
class PullOperations {
public:
    explicit PullOperations(const OperationLimits& limits,
        OpenEnumerations::Clock clock = std::chrono::steady_clock::now);

    static bool isOpening(CimXml::OperationKind kind);

    // Checks an operation that opens an enumeration before a provider is called. Throws Refusal:
    // filteredEnumerationNotSupported for a filter, continuationOnErrorNotSupported for
    // ContinueOnError, invalidOperationTimeout for one that is too long, or 0, which means none.
    void checkOpening(const CimXml::Operation& operation) const;

    // Leaves the objects for this response and keeps the rest to be pulled. Throws what
    // OpenEnumerations throws.
    Continuation open(
        const CimXml::Operation& operation, const std::string& principal, FoundObjects& found);

    // Returns the next objects. The operation's selection becomes that of the enumeration.
    Continuation pull(
        CimXml::Operation& operation, const std::string& principal, FoundObjects& found);
    void close(const CimXml::Operation& operation, const std::string& principal);

    // Frees the memory of enumerations that have timed out. Each operation calls it.
    void removeExpired() { enumerations_.removeExpired(); }

    // Returns the number of objects in the memory of open enumerations.
    std::size_t heldObjects() const { return enumerations_.heldObjects(); }

private:
    std::size_t countFor(const CimXml::Operation& operation) const;

    const OperationLimits limits_;
    OpenEnumerations enumerations_;
};

} // namespace Host
