// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "host/http/Certificate.h"
#include "host/http/Connections.h"
#include "host/http/Limits.h"
#include "host/http/Resource.h"
#include "host/http/ResponseCounts.h"
#include "host/http/SignIns.h"
#include "host/http/UnsentObjects.h"
#include "host/http/WorkSlots.h"

#include <cstddef>
#include <memory>
#include <mutex>
#include <utility>

namespace Host::Http {

// The certificate that new connections are shown. Thread-safe.
class CurrentCertificate {
public:
    // Null for a server without TLS.
    explicit CurrentCertificate(std::shared_ptr<const Certificate> first)
        : certificate_(std::move(first))
    {
    }

    std::shared_ptr<const Certificate> get() const
    {
        const std::lock_guard lock(mutex_);
        return certificate_;
    }
    void replace(std::shared_ptr<const Certificate> certificate)
    {
        const std::lock_guard lock(mutex_);
        certificate_ = std::move(certificate);
    }

private:
    mutable std::mutex mutex_;
    std::shared_ptr<const Certificate> certificate_;
};

// Requests for resources that are answered at a time; others wait.
inline constexpr std::size_t maximumReaders = 32;

// What all connections of a server share.
struct Service {
    Service(CimXml::OperationHandler& handler, Resources given, const Limits& bounds,
        std::shared_ptr<const Certificate> firstCertificate,
        std::shared_ptr<const Passwords> passwords, ResponseCounts* counts)
        : operations(handler), resources(std::move(given)), limits(bounds),
          certificate(std::move(firstCertificate)),
          signIns(std::move(passwords), limits.signInDelay), unsent(limits.maximumUnsentObjects),
          work(limits.workers, limits.maximumQueue), readers(maximumReaders, limits.maximumQueue),
          readersSigningIn(1, limits.maximumQueue), responses(counts)
    {
    }

    CimXml::OperationHandler& operations;
    const Resources resources;
    const Limits limits;
    CurrentCertificate certificate;
    SignIns signIns;
    UnsentObjects unsent;
    WorkSlots work;
    // Those who read resources wait for no operation, and no operation waits for them.
    WorkSlots readers;
    WorkSlots readersSigningIn;
    ResponseCounts* const responses; // may be null
    Connections connections{limits};
};

} // namespace Host::Http
