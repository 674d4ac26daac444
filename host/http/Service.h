// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "host/http/Certificate.h"
#include "host/http/Connections.h"
#include "host/http/Limits.h"
#include "host/http/SignIns.h"
#include "host/http/UnsentObjects.h"
#include "host/http/WorkSlots.h"

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

// What all connections of a server share.
struct Service {
    Service(CimXml::OperationHandler& handler, const Limits& given,
        std::shared_ptr<const Certificate> firstCertificate,
        std::shared_ptr<const Passwords> passwords)
        : operations(handler), limits(given), certificate(std::move(firstCertificate)),
          signIns(std::move(passwords), given.signInDelay), unsent(given.maximumUnsentObjects),
          work(given.workers, given.maximumQueue)
    {
    }

    CimXml::OperationHandler& operations;
    const Limits limits;
    CurrentCertificate certificate;
    SignIns signIns;
    UnsentObjects unsent;
    WorkSlots work;
    Connections connections{limits};
};

} // namespace Host::Http
