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

class InteropProviderTest : public testing::Test {
protected:
    // Returns the names of the properties of the only object manager.
    std::vector<std::string> objectManager(const char** properties)
    {
        const auto answer = manager_.enumerateInstances(request_.context(),
            request_.makePath(Host::interopNameSpace, Host::objectManagerClass), properties);
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

    Host::ObjectPath& objectManagerPath(const char* key, std::string_view name)
    {
        auto& path = request_.makePath(Host::interopNameSpace, Host::objectManagerClass);
        const auto addKey = [&](const char* keyName, std::string_view text) {
            path.addKey(keyName, Host::Value::text(request_.arena(), text));
        };
        addKey("SystemCreationClassName", "ZUMLO_ComputerSystem");
        addKey("SystemName", hostName_);
        addKey("CreationClassName", Host::objectManagerClass);
        addKey(key, name);
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
    const char* list[] = {"healthstate", "Unheard", nullptr};
    EXPECT_THAT(objectManager(list), ElementsAre("SystemCreationClassName", "SystemName",
                                         "CreationClassName", "Name", "HealthState"));
    const char* nothing[] = {nullptr};
    EXPECT_THAT(objectManager(nothing),
        ElementsAre("SystemCreationClassName", "SystemName", "CreationClassName", "Name"));
}

TEST_F(InteropProviderTest, WhatOneAskedForLeavesTheObjectsAsTheyAre)
{
    const char* nothing[] = {nullptr};
    objectManager(nothing);
    EXPECT_EQ(objectManager(nullptr).size(), 13U);
}

TEST_F(InteropProviderTest, AnObjectIsFoundByAllItsKeys)
{
    EXPECT_TRUE(isFound(objectManagerPath("NAME", "sensor-profile")));
    EXPECT_FALSE(isFound(objectManagerPath("Name", "Sensor-Profile")));
    EXPECT_FALSE(isFound(request_.makePath(Host::interopNameSpace, Host::objectManagerClass)));
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
    EXPECT_EQ(answer.instances().size(), 3U);
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
