// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A dispatcher with scripted providers: Things serves the class Thing, Gauges its subclass Gauge,
// and Links the association Link.

#pragma once

#include "host/broker/ObjectPath.h"
#include "host/manager/Manager.h"
#include "host/operations/Dispatcher.h"
#include "tests/host/manager/ScriptedProvider.h"
#include "tests/host/operations/OperationsTest.h"

#include <cmpimacs.h>

#include <chrono>
#include <memory>
#include <string>
#include <utility>

namespace OperationTests {

using CimXmlTests::call;
using CimXmlTests::thing;
using Testing::ProviderCall;

inline constexpr CMPIStatus ok = {CMPI_RC_OK, nullptr};

class ScriptedManager {
public:
    explicit ScriptedManager(const Host::OperationLimits& limits = {})
        : dispatcher_(
              classes(), manager_, [this] { return hostName_; }, limits, [this] { return now_; })
    {
        for (const char* const name : {"Things", "Gauges", "Links"})
            script(name, [](const ProviderCall&) { return ok; });
    }

    OperationHandler& operator*() { return dispatcher_; }

    void script(const std::string& provider, Testing::ScriptedProvider::Handler handler)
    {
        providers_[provider].handle(std::move(handler));
    }

    // Has the provider of Thing deliver `count` objects, named by the numbers from 0.
    void deliverThings(unsigned count)
    {
        script("Things", [this, count](const ProviderCall& asked) {
            for (unsigned number = 0; number < count; ++number)
                deliver(asked, "Thing", std::to_string(number));
            return ok;
        });
    }

    // Delivers an instance or a path, according to the operation.
    CMPIStatus deliver(const ProviderCall& asked, const char* className, const std::string& name)
    {
        CMPIObjectPath* const path = CMNewObjectPath(broker(), "root/test", className, nullptr);
        const CMPIUint16 index = 7;
        CMAddKey(path, "Name", name.c_str(), CMPI_chars);
        CMAddKey(path, "Index", &index, CMPI_uint16);
        if (asked.operation.find("Name") != std::string::npos)
            return CMReturnObjectPath(asked.result, path);
        CMPIInstance* const instance = CMNewInstance(broker(), path, nullptr);
        CMSetProperty(instance, "Name", name.c_str(), CMPI_chars);
        CMSetProperty(instance, "Index", &index, CMPI_uint16);
        return CMReturnInstance(asked.result, instance);
    }

    CMPIStatus failure(CMPIrc code, const char* message) const
    {
        return {code, CMNewString(broker(), message, nullptr)};
    }

    void wait(std::chrono::seconds time) { now_ += time; }
    void renameHost(const std::string& name) { hostName_ = name; }

private:
    static const Host::Repository& classes()
    {
        static const auto compiled = Testing::compile(CimXmlTests::Classes);
        return *compiled;
    }

    const CMPIBroker* broker() const { return manager_.broker().handle(); }

    std::chrono::steady_clock::time_point now_;
    std::string hostName_ = "host.example";
    Testing::ScriptedProviders providers_;
    Host::Manager manager_{
        classes(), {Testing::registration(providers_, "Thing", "Things"),
                       Testing::registration(providers_, "Gauge", "Gauges"),
                       Testing::registration(providers_, "Link", "Links", true)}};
    Host::Dispatcher dispatcher_;
};

} // namespace OperationTests
