// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A request in the embedded broker, as a provider receives it, and its result.

#pragma once

#include "host/broker/Broker.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "host/broker/Result.h"
#include "host/broker/String.h"
#include "platform/utilities/ProviderUtilities.h"
#include "tests/support/Describe.h"
#include "tests/support/LogCapture.h"
#include "tests/support/ScriptedMachine.h"
#include "tests/support/TraceRecorder.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Testing {

inline std::string textOf(const CMPIString* string)
{
    const Host::String* const found = Host::String::of(string);
    return found ? std::string(found->text().value_or("(null)")) : "(null)";
}

class ProviderTest : public ::testing::Test {
protected:
    static constexpr const char* testNameSpace = "root/cimv2";

    // Returns a path with text keys; by default in the namespace of the requests.
    Host::ObjectPath& path(const char* className,
        const std::vector<std::pair<std::string, std::string>>& keys = {},
        const char* nameSpace = testNameSpace)
    {
        Host::ObjectPath& made = request_->makePath(nameSpace, className);
        for (const auto& [name, text] : keys)
            made.addKey(name, Host::Value::text(request_->arena(), text));
        return made;
    }

    const CMPIBroker* broker() const { return recorder_.handle(); }
    const CMPIContext* context() { return request_->context().handle(); }
    const CMPIResult* result() const { return result_.handle(); }

    Host::Broker broker_;
    TraceRecorder recorder_{broker_.handle()};
    std::vector<BrokerMessage>& messages_ = recorder_.messages;
    std::unique_ptr<Host::Request> request_ = std::make_unique<Host::Request>(broker_);
    Host::CollectedResult answer_;
    Host::Result result_{answer_};
    const std::string systemName_ = Vorn::getSystemName();
};

} // namespace Testing
