// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The embedded object manager's broker, which CMPI providers get when they are loaded.

#pragma once

#include "host/broker/Object.h"

namespace Host {

class BrokerUpcalls;
class ClassInformation;

// Any number of requests may run over one broker at once, each on its thread (see Request).
// Objects are made without locks. A broker must outlive the objects made through it and the
// providers that hold it.
class Broker : public Object {
public:
    using Handle = CMPIBroker;
    static constexpr Kind kindOfSelf = Kind::broker;

    Broker();
    Broker(const Broker&) = delete;
    Broker& operator=(const Broker&) = delete;

    // Returns the handle for providers. All function tables are complete: services that no shipped
    // provider calls return CMPI_RC_ERR_NOT_SUPPORTED.
    const CMPIBroker* handle() const noexcept { return &handle_; }
    // Returns the broker behind a handle; null when there is none of this kind.
    static const Broker* of(const CMPIBroker* handle) noexcept;

    // Sets the object that answers up-calls; by default there is none. REQUIRES: no request is
    // running.
    void setUpcalls(BrokerUpcalls* upcalls) noexcept { upcalls_ = upcalls; }
    // Sets the class information; null (the default) for none. REQUIRES: no request is running.
    void setClassInformation(const ClassInformation* classes) noexcept { classes_ = classes; }

    BrokerUpcalls* upcalls() const noexcept { return upcalls_; }
    const ClassInformation* classInformation() const noexcept { return classes_; }

private:
    CMPIBroker handle_;
    BrokerUpcalls* upcalls_ = nullptr;
    const ClassInformation* classes_ = nullptr;
};

} // namespace Host
