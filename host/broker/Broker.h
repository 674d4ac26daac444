// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The embedded object manager's broker: what a CMPI provider is handed when it is loaded.

#pragma once

#include "host/broker/Object.h"

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <utility>

namespace Host {

class Attachments;
class BrokerUpcalls;
class ClassInformation;

// A message a provider sent to the broker's trace facility. Its texts last for the call; a
// text that was not given is empty.
struct TraceMessage {
    CMPILevel level;
    std::string_view component;
    std::string_view text;
    std::string_view string; // the CMPIString beside the text
};

using TraceObserver = std::function<void(const TraceMessage&)>;

struct BrokerOptions {
    std::string name = "sensor-profile";
    // Some object managers have no memory services: their table is a null pointer.
    bool hasMemoryServices = true;
};

// Any number of requests may run over one broker at once, each on its thread (see Request).
// Objects are made without locks. A broker must outlive the objects made through it, clones
// included, and the providers that hold it.
class Broker : public Object {
public:
    using Handle = CMPIBroker;
    static constexpr Kind kindOfSelf = Kind::broker;

    explicit Broker(BrokerOptions options = {});
    ~Broker();
    Broker(const Broker&) = delete;
    Broker& operator=(const Broker&) = delete;

    // What providers get. All function tables are complete; what the broker does not offer
    // answers CMPI_RC_ERR_NOT_SUPPORTED.
    const CMPIBroker* handle() const noexcept { return &handle_; }
    // The broker behind a handle; null when there is none of this kind.
    static const Broker* of(const CMPIBroker* handle) noexcept;

    // What up-calls reach; null (the default) for nothing.
    // REQUIRES, like the two after it: no request is running.
    void setUpcalls(BrokerUpcalls* upcalls);
    // What is known about classes; null (the default) for nothing.
    void setClassInformation(const ClassInformation* classes) noexcept { classes_ = classes; }
    // Sees every message sent to the trace facility, on the provider's thread and beside the
    // trace channel of the log.
    void setTraceObserver(TraceObserver observer) { observer_ = std::move(observer); }

    BrokerUpcalls& upcalls() const noexcept { return *upcalls_; }
    const ClassInformation* classInformation() const noexcept { return classes_; }
    const TraceObserver& traceObserver() const noexcept { return observer_; }
    Attachments& attachments() const noexcept { return *attachments_; }

private:
    std::string name_;
    CMPIBrokerFT upcallTable_;
    CMPIBroker handle_;
    BrokerUpcalls* upcalls_;
    const ClassInformation* classes_ = nullptr;
    TraceObserver observer_;
    std::unique_ptr<Attachments> attachments_;
};

} // namespace Host
