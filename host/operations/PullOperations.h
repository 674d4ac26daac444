// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Operations that open an enumeration, pull from it and close it.

#pragma once

#include "host/cimxml/Operation.h"
#include "host/operations/ObjectResponse.h"
#include "host/operations/OpenEnumerations.h"

#include <string>

namespace Host {

// May be used from any thread.
class PullOperations {
public:
    explicit PullOperations(const OperationLimits& limits,
        OpenEnumerations::Clock clock = std::chrono::steady_clock::now);

    static bool isOpening(CimXml::OperationKind kind);

    // To be called before anything is enumerated. Throws Refusal: filteredEnumerationNotSupported
    // for a filter, continuationOnErrorNotSupported when the client wants to go on after errors,
    // invalidOperationTimeout for a time that is too long, or for the 0 that stands for ever.
    void checkOpening(const CimXml::Operation& operation) const;

    // Leaves in the answer what the client wants at once and keeps the rest for it. Throws what
    // OpenEnumerations throws.
    Continuation open(
        const CimXml::Operation& operation, const std::string& principal, FoundObjects& found);

    // The operation's selection becomes that of the enumeration.
    Continuation pull(
        CimXml::Operation& operation, const std::string& principal, FoundObjects& found);
    void close(const CimXml::Operation& operation, const std::string& principal);

    // Gives back the memory of enumerations whose time is over; to be called with all operations.
    void removeExpired() { enumerations_.removeExpired(); }

private:
    std::size_t countFor(const CimXml::Operation& operation) const;

    const OperationLimits limits_;
    OpenEnumerations enumerations_;
};

} // namespace Host
