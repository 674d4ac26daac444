// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/broker/Tables.h"

#include <cmpidt.h>
#include <cmpift.h>

#include <algorithm>
#include <ostream>
#include <string>
#include <vector>

namespace Testing {

// A message to the broker's trace facility.
struct BrokerMessage {
    unsigned level;
    std::string component;
    std::string text;

    bool operator==(const BrokerMessage&) const = default;
};

inline std::ostream& operator<<(std::ostream& out, const BrokerMessage& message)
{
    return out << message.level << ' ' << message.component << ": " << message.text;
}

// Records the trace messages of a broker through another handle of it. Of several recorders of a
// broker, the last one records a message. Used by one thread.
class TraceRecorder {
public:
    explicit TraceRecorder(const CMPIBroker* broker) : handle_(*broker)
    {
        handle_.eft = &functions();
        all_.push_back(this);
    }
    ~TraceRecorder() { std::erase(all_, this); }
    TraceRecorder(const TraceRecorder&) = delete;
    TraceRecorder& operator=(const TraceRecorder&) = delete;

    const CMPIBroker* handle() const { return &handle_; }

    // Returns the embedded broker's table with a slot that records trace messages.
    static const CMPIBrokerEncFT& functions()
    {
        static const CMPIBrokerEncFT table = [] {
            CMPIBrokerEncFT copy = Host::encapsulationFunctions;
            copy.trace = &record;
            return copy;
        }();
        return table;
    }

    std::vector<BrokerMessage> messages;

private:
    static CMPIStatus record(const CMPIBroker* broker, CMPILevel level, const char* component,
        const char* text, const CMPIString* string)
    {
        const auto found = std::find_if(all_.rbegin(), all_.rend(),
            [&](const TraceRecorder* each) { return each->handle_.hdl == broker->hdl; });
        if (found != all_.rend())
            (*found)->messages.push_back({static_cast<unsigned>(level), component, text});
        return Host::encapsulationFunctions.trace(broker, level, component, text, string);
    }

    inline static std::vector<TraceRecorder*> all_;
    CMPIBroker handle_;
};

} // namespace Testing
