// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A request to a provider whose broker injects faults.

#pragma once

#include "tests/support/FaultSweep.h"
#include "tests/support/ProviderTest.h"

#include <algorithm>
#include <functional>
#include <memory>
#include <ostream>
#include <string>
#include <vector>

namespace Testing {

// The operation of a request and its object path.
struct RequestKind {
    std::string name;
    std::function<Host::ObjectPath&(const Host::Request&)> source;
    std::function<CMPIStatus(
        const CMPIBroker*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*)>
        run;
};

inline std::ostream& operator<<(std::ostream& out, const RequestKind& kind)
{
    return out << kind.name;
}

// Sends one request with the given broker, and holds its result, status and trace messages.
class FaultyRequest {
public:
    FaultyRequest(Host::Broker& broker, FaultyBroker& faulty, const RequestKind& kind)
        : request_(broker)
    {
        const TraceRecorder recorder(faulty.handle());
        const CMPIObjectPath* const source = faulty.watch(kind.source(request_).handle());
        const Strings recording(faulty.handle()->eft, &strings_);
        CMPIBrokerEncFT functions = *faulty.handle()->eft;
        functions.newString = &Strings::make;
        CMPIBroker recorded = *faulty.handle();
        recorded.eft = &functions;
        status = kind.run(
            &recorded, request_.context().handle(), faulty.watch(result_.handle()), source);
        messages = recorder.messages;
    }

    std::string message() const { return textOf(status.msg); }
    // Returns the last string that the provider created, "none" when there is none.
    std::string lastString() const { return strings_.empty() ? "none" : strings_.back(); }
    BrokerMessage lastMessage() const
    {
        return messages.empty() ? BrokerMessage{} : messages.back();
    }

    Host::CollectedResult answer;
    std::vector<BrokerMessage> messages;
    CMPIStatus status = {};

private:
    // Records the texts of the strings that are created during its lifetime.
    class Strings {
    public:
        Strings(const CMPIBrokerEncFT* functions, std::vector<std::string>* texts)
            : functions_(functions), texts_(texts)
        {
            inForce_ = this;
        }
        ~Strings() { inForce_ = nullptr; }
        Strings(const Strings&) = delete;
        Strings& operator=(const Strings&) = delete;

        static CMPIString* make(const CMPIBroker* broker, const char* text, CMPIStatus* rc)
        {
            inForce_->texts_->emplace_back(text);
            return inForce_->functions_->newString(broker, text, rc);
        }

    private:
        inline static const Strings* inForce_ = nullptr;
        const CMPIBrokerEncFT* functions_;
        std::vector<std::string>* texts_;
    };

    std::vector<std::string> strings_;
    Host::Request request_;
    Host::Result result_{answer};
};

class FaultTest : public ::testing::Test {
protected:
    // Runs the request with faults, and expects all of them to occur.
    std::unique_ptr<FaultyRequest> run(const RequestKind& kind, const std::vector<Fault>& faults)
    {
        faulty_.reset(); // only the last one constructed is active: the old one is destroyed first
        faulty_ = std::make_unique<FaultyBroker>(broker_);
        for (const Fault& fault : faults)
            faulty_->plan(fault);
        auto request = std::make_unique<FaultyRequest>(broker_, *faulty_, kind);
        EXPECT_EQ(faulty_->fired(), faults.size()) << "the request does not get to the fault";
        return request;
    }
    std::unique_ptr<FaultyRequest> run(const RequestKind& kind, const Fault& fault)
    {
        return run(kind, std::vector<Fault>{fault});
    }

    // Runs the request with a fault in the last call of the kind, by default an error status beside
    // the result.
    std::unique_ptr<FaultyRequest> runWithLast(
        const RequestKind& kind, BrokerCall call, FaultManner manner = FaultManner::errorStatus)
    {
        run(kind, std::vector<Fault>{});
        const unsigned last = faulty_->count(call);
        return run(kind, {call, last, manner, CMPI_RC_ERR_ACCESS_DENIED});
    }

    // Returns how often the last request called this function of a path of the class.
    std::ptrdiff_t timesCalled(const std::string& call, const std::string& className) const
    {
        const std::vector<std::string>& calls = faulty_->pathCalls();
        return std::count(calls.begin(), calls.end(), call + " " + className);
    }

    // The manners in which a call fails to return its object.
    static constexpr FaultManner undelivered[] = {FaultManner::nullResult, FaultManner::handleless};

    Host::Broker broker_;
    std::unique_ptr<FaultyBroker> faulty_;
};

} // namespace Testing
