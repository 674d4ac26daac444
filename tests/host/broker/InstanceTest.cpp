// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Instance.h"

#include "host/broker/Array.h"
#include "host/broker/String.h"
#include "tests/host/broker/BrokerTest.h"
#include "tests/support/ClassTable.h"

namespace HostTests {

class InstanceTest : public BrokerTest {
protected:
    static void set(CMPIInstance* object, const char* name, const char* text)
    {
        EXPECT_EQ(CMSetProperty(object, name, text, CMPI_chars).rc, CMPI_RC_OK);
    }
    static const Host::Value* property(const CMPIInstance* object, const char* name)
    {
        return Host::Instance::of(object)->property(name);
    }
    // Returns names and values in order, such as "A=1,B=2".
    static std::string propertiesOf(const CMPIInstance* object)
    {
        std::string all;
        for (const auto& [name, value] : Host::Instance::of(object)->properties())
            all.append(all.empty() ? "" : ",")
                .append(*name->text())
                .append("=")
                .append(value.text().value_or("?"));
        return all;
    }
    static std::string keysOf(const CMPIInstance* object)
    {
        return Host::ObjectPath::of(CMGetObjectPath(object, nullptr))->toText();
    }
    static void filter(
        CMPIInstance* object, std::vector<const char*> properties, std::vector<const char*> keys)
    {
        properties.push_back(nullptr);
        keys.push_back(nullptr);
        EXPECT_EQ(CMSetPropertyFilter(object, properties.data(), keys.data()).rc, CMPI_RC_OK);
    }
    static void keyNames(CMPIInstance* object, std::vector<const char*> keys)
    {
        keys.push_back(nullptr);
        EXPECT_EQ(CMSetPropertyFilter(object, nullptr, keys.data()).rc, CMPI_RC_OK);
    }
};

TEST_F(InstanceTest, NeedsAPath)
{
    EXPECT_EQ(CMNewInstance(mb, nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(InstanceTest, KeepsPropertiesInTheOrderTheyWereSet)
{
    CMPIInstance* const made = instance();
    for (const char* const name : {"B", "A", "E", "D", "C"})
        set(made, name, name);
    set(made, "a", "again");
    EXPECT_EQ(propertiesOf(made), "B=B,A=again,E=E,D=D,C=C");
}

TEST_F(InstanceTest, FindsAPropertyWithoutRegardToLetterCase)
{
    CMPIInstance* const made = instance();
    set(made, "ElementName", "Fan");
    EXPECT_EQ(property(made, "elementNAME")->text(), "Fan");
    EXPECT_EQ(property(made, "Other"), nullptr);
    EXPECT_EQ(CMSetProperty(made, nullptr, "1", CMPI_chars).rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(InstanceTest, ANullValueIsANullProperty)
{
    CMPIInstance* const made = instance();
    EXPECT_EQ(CMSetProperty(made, "A", nullptr, CMPI_uint16).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetProperty(made, "B", nullptr, CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(property(made, "A")->type(), CMPI_uint16);
    EXPECT_TRUE(property(made, "A")->isNull());
    EXPECT_EQ(property(made, "B")->type(), CMPI_string);
}

TEST_F(InstanceTest, CopiesArraysDeep)
{
    CMPIInstance* const made = instance();
    CMPIArray* const numbers = array({1, 2});
    CMSetProperty(made, "A", &numbers, CMPI_uint16A);
    const CMPIUint16 changed = 9;
    CMSetArrayElementAt(numbers, 0, &changed, CMPI_uint16);
    const auto elements = property(made, "A")->array()->elements();
    EXPECT_EQ(elements[0].unsignedInteger(), 1U);
    EXPECT_EQ(Host::Array::of(numbers)->elements()[0].unsignedInteger(), 9U);
}

TEST_F(InstanceTest, CopiesEmbeddedInstancesDeep)
{
    CMPIInstance* const made = instance();
    CMPIInstance* const embedded = instance("Embedded");
    set(embedded, "A", "before");
    CMSetProperty(made, "I", &embedded, CMPI_instance);
    set(embedded, "A", "after");
    EXPECT_EQ(property(made, "I")->instance()->property("A")->text(), "before");
}

TEST_F(InstanceTest, TheFilterDropsWhatIsNeitherListedNorAKey)
{
    CMPIInstance* const made = instance();
    filter(made, {"Name", "status"}, {"DeviceID"});
    for (const char* const name : {"DeviceID", "NAME", "Other", "Status"})
        set(made, name, "1");
    EXPECT_EQ(propertiesOf(made), "DeviceID=1,NAME=1,Status=1");
}

TEST_F(InstanceTest, TheFilterRemovesWhatWasSetBefore)
{
    CMPIInstance* const made = instance();
    for (const char* const name : {"A", "B", "C", "D", "E", "F"})
        set(made, name, "1");
    filter(made, {"b", "F"}, {"c"});
    EXPECT_EQ(propertiesOf(made), "B=1,C=1,F=1");
}

TEST_F(InstanceTest, AnEmptyListLeavesOnlyKeys)
{
    CMPIInstance* const made = instance();
    filter(made, {}, {"A"});
    set(made, "A", "1");
    set(made, "B", "1");
    EXPECT_EQ(propertiesOf(made), "A=1");
}

TEST_F(InstanceTest, WithoutAListNothingIsDropped)
{
    CMPIInstance* const made = instance();
    keyNames(made, {"A"});
    set(made, "A", "1");
    set(made, "B", "1");
    EXPECT_EQ(propertiesOf(made), "A=1,B=1");
    EXPECT_EQ(CMSetPropertyFilter(made, nullptr, nullptr).rc, CMPI_RC_OK);
    EXPECT_EQ(propertiesOf(made), "A=1,B=1");
}

TEST_F(InstanceTest, TheFilterCopiesItsLists)
{
    CMPIInstance* const made = instance();
    std::string wanted = "A";
    std::string key = "K";
    const char* properties[] = {wanted.c_str(), nullptr};
    const char* keys[] = {key.c_str(), nullptr};
    CMSetPropertyFilter(made, properties, keys);
    wanted[0] = key[0] = 'Z';
    properties[0] = keys[0] = nullptr;
    set(made, "A", "1");
    set(made, "K", "1");
    set(made, "Z", "1");
    EXPECT_EQ(propertiesOf(made), "A=1,K=1");
}

TEST_F(InstanceTest, ALaterFilterReplacesTheEarlierOne)
{
    CMPIInstance* const made = instance();
    filter(made, {"A"}, {});
    filter(made, {"B"}, {});
    set(made, "A", "1");
    set(made, "B", "1");
    EXPECT_EQ(propertiesOf(made), "B=1");
}

TEST_F(InstanceTest, OneFilterServesInstancesWhosePropertiesAreSetInAnyOrder)
{
    for (const std::string_view order : {"KABCD", "DCBAK", "CKDBA", "AABBKKCC"}) {
        CMPIInstance* const made = instance();
        filter(made, {"D", "b", "A", "A"}, {"K"});
        for (const char name : order)
            set(made, std::string(1, name).c_str(), "1");
        EXPECT_EQ(property(made, "C"), nullptr) << order;
        for (const char name : order)
            EXPECT_EQ(property(made, std::string(1, name).c_str()) != nullptr, name != 'C')
                << order;
    }
}

TEST_F(InstanceTest, FiltersOfSeveralInstancesStayApart)
{
    CMPIInstance* const first = instance();
    filter(first, {"A"}, {"K"});
    CMPIInstance* const second = instance();
    filter(second, {"A", "B"}, {"K"});
    CMPIInstance* const third = instance();
    keyNames(third, {"L"});
    CMPIInstance* const fourth = instance();
    filter(fourth, {}, {"L"});
    for (const char* const name : {"A", "B", "K", "L"})
        for (CMPIInstance* const each : {first, second, third, fourth})
            set(each, name, "1");
    EXPECT_EQ(propertiesOf(first), "A=1,K=1");
    EXPECT_EQ(propertiesOf(second), "A=1,B=1,K=1");
    EXPECT_EQ(propertiesOf(third), "A=1,B=1,K=1,L=1");
    EXPECT_EQ(propertiesOf(fourth), "L=1");
}

TEST_F(InstanceTest, WithoutKeyNamesThePathIsAsGiven)
{
    CMPIInstance* const made = instance();
    set(made, "DeviceID", "fan1");
    EXPECT_EQ(keysOf(made), "root/cimv2:Test_Class");
}

TEST_F(InstanceTest, ThePathCarriesTheKeysNamedInTheFilter)
{
    CMPIObjectPath* const given = path();
    CMSetHostname(given, "host.example");
    CMPIInstance* const made = CMNewInstance(mb, given, nullptr);
    filter(made, {}, {"DeviceID", "SystemName"});
    set(made, "SystemName", "host");
    set(made, "DeviceID", "fan1");
    EXPECT_EQ(
        keysOf(made), "//host.example/root/cimv2:Test_Class.DeviceID=\"fan1\",SystemName=\"host\"");
}

TEST_F(InstanceTest, KeysThatTheInstanceLacksAreLeftOut)
{
    CMPIInstance* const made = instance();
    keyNames(made, {"Antecedent", "Dependent"});
    set(made, "GroupComponent", "x");
    EXPECT_EQ(keysOf(made), "root/cimv2:Test_Class");
    CMSetProperty(made, "Antecedent", nullptr, CMPI_chars);
    set(made, "Dependent", "y");
    EXPECT_EQ(keysOf(made), "root/cimv2:Test_Class.Dependent=\"y\"");
}

TEST_F(InstanceTest, WhatIsKnownAboutTheClassWinsOverTheFiltersKeyNames)
{
    Testing::ClassTable classes;
    classes.add("Test_Class", {"DeviceID"});
    broker.setClassInformation(&classes);
    CMPIInstance* const made = instance("test_CLASS");
    keyNames(made, {"Other"});
    set(made, "Other", "1");
    set(made, "deviceid", "fan1");
    EXPECT_EQ(keysOf(made), "root/cimv2:test_CLASS.DeviceID=\"fan1\"");
    filter(made, {}, {});
    EXPECT_EQ(propertiesOf(made), "deviceid=fan1");
}

TEST_F(InstanceTest, OfAClassThatIsNotKnownTheFiltersKeyNamesCount)
{
    Testing::ClassTable classes;
    classes.add("Other_Class", {"DeviceID"});
    broker.setClassInformation(&classes);
    CMPIInstance* const made = instance();
    keyNames(made, {"A"});
    set(made, "A", "1");
    EXPECT_EQ(keysOf(made), "root/cimv2:Test_Class.A=\"1\"");
}

TEST_F(InstanceTest, ThePathIsFreshAndShowsTheKeysAsTheyAreNow)
{
    CMPIInstance* const made = instance();
    keyNames(made, {"A"});
    set(made, "A", "1");
    CMPIObjectPath* const first = CMGetObjectPath(made, &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    CMSetNameSpace(first, "changed");
    set(made, "A", "2");
    EXPECT_EQ(keysOf(made), "root/cimv2:Test_Class.A=\"2\"");
    EXPECT_EQ(textOf(CMGetKey(first, "A", nullptr)), "1");
}

TEST_F(InstanceTest, ReferencesAndArraysAsKeyProperties)
{
    CMPIInstance* const made = instance();
    keyNames(made, {"Ref", "List"});
    CMPIObjectPath* const reference = path("Referred");
    CMPIArray* const list = array({1});
    CMSetProperty(made, "Ref", &reference, CMPI_ref);
    CMSetProperty(made, "List", &list, CMPI_uint16A);
    EXPECT_EQ(keysOf(made), "root/cimv2:Test_Class.Ref=\"root/cimv2:Referred\"");
}

TEST_F(InstanceTest, KeepsItsOwnCopyOfThePath)
{
    CMPIObjectPath* const given = path();
    CMAddKey(given, "A", "1", CMPI_chars);
    CMPIInstance* const made = CMNewInstance(mb, given, nullptr);
    CMSetNameSpace(given, "changed");
    CMAddKey(given, "A", "changed", CMPI_chars);
    EXPECT_EQ(keysOf(made), "root/cimv2:Test_Class.A=\"1\"");
}

} // namespace HostTests
