// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A manager with scripted providers, and a request in progress.
//
//   Thing         Box, Part (and SpecialPart below it), Idle, which nobody serves
//   Link          BoxLink: Whole -> Box, Piece -> Part
//                 ThingLink: Whole -> Box, Piece -> Thing

#pragma once

#include "host/broker/CollectedResult.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"
#include "host/broker/Request.h"
#include "host/broker/String.h"
#include "host/manager/Manager.h"
#include "tests/host/manager/ScriptedProvider.h"
#include "tests/support/ClassTable.h"

#include <cmpimacs.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <optional>
#include <string>
#include <vector>

namespace Testing {

inline constexpr const char* testNameSpace = "root/cimv2";

inline std::string orNone(const char* text)
{
    return text == nullptr ? "-" : text;
}

// Returns the code and the message of the Refusal that an operation throws; "code 0" when it does
// not fail.
template <typename Operation>
std::string refusalOf(const Operation& operation)
{
    try {
        operation();
    } catch (const Host::Refusal& refusal) {
        return "code " + std::to_string(refusal.code()) + ": " + refusal.what();
    }
    return "code 0";
}

class ManagerTest : public ::testing::Test {
protected:
    ManagerTest()
    {
        for (const char* const name : {"Boxes", "Parts", "SpecialParts", "BoxLinks", "ThingLinks"})
            script(name, [this](const ProviderCall& call) { return answer(call); });
    }

    // Replaces a provider's handler. The call is recorded before the handler runs.
    void script(const std::string& provider, const ScriptedProvider::Handler& handler)
    {
        providers_[provider].handle([this, provider, handler](const ProviderCall& call) {
            calls_.push_back(provider + " " + call.operation + " " + classOf(call.path));
            return handler(call);
        });
    }

    // Delivers one object of the requested class.
    CMPIStatus answer(const ProviderCall& call)
    {
        return deliver(call, classOf(call.path).c_str(), "one");
    }

    // Delivers an object of a class, as an instance or as a path, according to the operation.
    CMPIStatus deliver(const ProviderCall& call, const char* className, const char* name)
    {
        CMPIObjectPath* const path = CMNewObjectPath(broker(), testNameSpace, className, nullptr);
        CMAddKey(path, "Name", name, CMPI_chars);
        const bool wantsNames = call.operation.find("Name") != std::string::npos;
        if (wantsNames)
            return CMReturnObjectPath(call.result, path);
        CMPIInstance* const instance = CMNewInstance(broker(), path, nullptr);
        CMSetProperty(instance, "Name", name, CMPI_chars);
        return CMReturnInstance(call.result, instance);
    }

    CMPIStatus failure(CMPIrc code, const char* message) const
    {
        return {code, CMNewString(broker(), message, nullptr)};
    }

    const CMPIBroker* broker() const { return manager_.broker().handle(); }

    static std::string classOf(const CMPIObjectPath* path)
    {
        return std::string(Host::ObjectPath::of(path)->className());
    }

    Host::ObjectPath& path(std::string_view className)
    {
        return request_->makePath(testNameSpace, className);
    }

    const Host::Context& context() { return request_->context(); }

    static ClassTable classes();

    // Returns the class names of the delivered objects.
    static std::vector<std::string> delivered(const Host::CollectedResult& answer)
    {
        std::vector<std::string> classes;
        for (const Host::Instance* const instance : answer.instances())
            classes.emplace_back(instance->className());
        for (const Host::ObjectPath* const path : answer.paths())
            classes.emplace_back(path->className());
        return classes;
    }

    const ClassTable classes_ = classes();
    ScriptedProviders providers_;
    std::vector<std::string> calls_;
    Host::Manager manager_{classes_,
        {registration(providers_, "Box", "Boxes"), registration(providers_, "Part", "Parts"),
            registration(providers_, "SpecialPart", "SpecialParts"),
            registration(providers_, "BoxLink", "BoxLinks", true),
            registration(providers_, "ThingLink", "ThingLinks", true)}};
    std::optional<Host::Request> request_{std::in_place, manager_.broker()};
};

inline ClassTable ManagerTest::classes()
{
    ClassTable classes;
    classes.add("Thing", {});
    classes.add("Box", {"Name"}, "Thing");
    classes.add("Part", {"Name"}, "Thing");
    classes.add("SpecialPart", {"Name"}, "Part");
    classes.add("Idle", {"Name"}, "Thing");
    classes.add("Link", {"Whole", "Piece"}, {}, {{"Whole", "Thing"}, {"Piece", "Thing"}});
    classes.add("BoxLink", {"Whole", "Piece"}, "Link", {{"Whole", "Box"}, {"Piece", "Part"}});
    classes.add("ThingLink", {"Whole", "Piece"}, "Link", {{"Whole", "Box"}, {"Piece", "Thing"}});
    return classes;
}

} // namespace Testing
