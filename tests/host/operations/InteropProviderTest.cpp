// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The provider of root/interop, called by the manager and by up-calls.

#include "host/operations/InteropProvider.h"

#include "host/broker/CollectedResult.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"
#include "host/broker/Request.h"
#include "host/broker/String.h"
#include "host/manager/Manager.h"
#include "tests/support/ShippedClasses.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using testing::ElementsAre;
using testing::UnorderedElementsAre;

class InteropProviderTest : public testing::Test {
protected:
    // Returns the names of the properties of the only profile.
    std::vector<std::string> profile(const char** properties)
    {
        const auto answer = manager_.enumerateInstances(request_.context(),
            request_.makePath(Host::interopNameSpace, Host::registeredProfileClass), properties);
        EXPECT_EQ(answer.instances().size(), 1U);
        std::vector<std::string> names;
        for (const Host::NamedValue& property : answer.instances().at(0)->properties())
            names.emplace_back(*property.name->text());
        return names;
    }

    bool isFound(const Host::ObjectPath& path)
    {
        try {
            manager_.getInstance(request_.context(), path, nullptr);
            return true;
        } catch (const Host::Refusal& refusal) {
            EXPECT_EQ(refusal.code(), CMPI_RC_ERR_NOT_FOUND) << refusal.what();
            return false;
        }
    }

    Host::ObjectPath& profilePath(const char* key, std::string_view value)
    {
        auto& path = request_.makePath(Host::interopNameSpace, Host::registeredProfileClass);
        path.addKey(key, Host::Value::text(request_.arena(), value));
        return path;
    }

    const std::unique_ptr<const Host::Repository> classes_ = Testing::shippedClasses();
    std::string hostName_ = "host.example";
    Host::InteropProvider interop_{*classes_, [this] { return hostName_; }};
    Host::Manager manager_{*classes_, interop_.registrations()};
    Host::Request request_{manager_.broker()};
};

TEST_F(InteropProviderTest, AListLeavesOutAllButTheKeysAndWhatItNames)
{
    const char* list[] = {"registeredname", "Unheard", nullptr};
    EXPECT_THAT(profile(list), ElementsAre("InstanceID", "RegisteredName"));
    const char* nothing[] = {nullptr};
    EXPECT_THAT(profile(nothing), ElementsAre("InstanceID"));
}

TEST_F(InteropProviderTest, WhatOneAskedForLeavesTheObjectsAsTheyAre)
{
    const char* nothing[] = {nullptr};
    profile(nothing);
    EXPECT_THAT(profile(nullptr),
        UnorderedElementsAre("InstanceID", "ElementName", "RegisteredOrganization",
            "RegisteredName", "RegisteredVersion", "AdvertiseTypes"));
}

TEST_F(InteropProviderTest, AnObjectIsFoundByAllItsKeys)
{
    EXPECT_TRUE(isFound(profilePath("INSTANCEID", "ZUMLO:DSP1009")));
    EXPECT_FALSE(isFound(profilePath("InstanceID", "zumlo:dsp1009")));
    EXPECT_FALSE(isFound(request_.makePath(Host::interopNameSpace, Host::registeredProfileClass)));
    EXPECT_FALSE(isFound(request_.makePath(Host::interopNameSpace, Host::namespaceClass)));
}

TEST_F(InteropProviderTest, ThereIsOneNamespaceObjectForEachNamespace)
{
    const auto answer = manager_.enumerateInstanceNames(
        request_.context(), request_.makePath(Host::interopNameSpace, Host::namespaceClass));
    std::vector<std::string> names;
    for (const Host::ObjectPath* const path : answer.paths())
        names.emplace_back(*path->key("Name")->text());
    EXPECT_THAT(names, ElementsAre("root/cimv2", "root/interop"));
}

TEST_F(InteropProviderTest, TheSystemIsNamedAsItIsNow)
{
    const auto systemName = [&](const char* className) {
        const auto answer = manager_.enumerateInstances(
            request_.context(), request_.makePath(Host::interopNameSpace, className), nullptr);
        return std::string(*answer.instances().at(0)->property("SystemName")->text());
    };
    EXPECT_EQ(systemName(Host::objectManagerClass), "host.example");
    hostName_ = "renamed.example";
    EXPECT_EQ(systemName(Host::objectManagerClass), "renamed.example");
    EXPECT_EQ(systemName(Host::namespaceClass), "renamed.example");
}

TEST_F(InteropProviderTest, EveryPropertyIsDeclaredWithItsType)
{
    const auto answer = manager_.enumerateInstances(request_.context(),
        request_.makePath(Host::interopNameSpace, "CIM_ManagedElement"), nullptr);
    EXPECT_EQ(answer.instances().size(), 4U);
    for (const Host::Instance* const instance : answer.instances()) {
        const auto* const declared =
            classes_->findClass(Host::interopNameSpace, instance->className());
        ASSERT_NE(declared, nullptr);
        for (const Host::NamedValue& each : instance->properties()) {
            const auto* const property = declared->property(*each.name->text());
            ASSERT_NE(property, nullptr) << *each.name->text();
            EXPECT_EQ(property->name, *each.name->text());
            EXPECT_EQ(property->type, each.value.type()) << property->name;
        }
    }
}

} // namespace
