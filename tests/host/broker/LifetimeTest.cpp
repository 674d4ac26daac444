// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Who lives how long: objects of a request, clones, and the memory behind them.

#include "host/broker/CollectedResult.h"
#include "host/broker/Instance.h"
#include "host/broker/Result.h"
#include "tests/host/broker/BrokerTest.h"
#include "tests/support/CountingMemory.h"

#include <array>

namespace HostTests {

namespace {

class LifetimeTest : public testing::Test {
protected:
    CMPIObjectPath* makePath()
    {
        CMPIObjectPath* const made = CMNewObjectPath(mb, "root/cimv2", "Test_Class", nullptr);
        CMAddKey(made, "DeviceID", "fan1", CMPI_chars);
        return made;
    }

    Testing::CountingMemory memory;
    Host::Broker broker;
    const CMPIBroker* mb = broker.handle();
    CMPIStatus rc{CMPI_RC_OK, nullptr};
};

} // namespace

TEST_F(LifetimeTest, WithoutARequestNothingIsMade)
{
    EXPECT_EQ(CMNewString(mb, "text", &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(rc.msg, nullptr);
    EXPECT_EQ(CMNewObjectPath(mb, "root/cimv2", "Test_Class", &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(CMNewArray(mb, 1, CMPI_uint16, &rc), nullptr);
    EXPECT_EQ(CMNewArgs(mb, &rc), nullptr);
    EXPECT_EQ(CMNewDateTime(mb, &rc), nullptr);
    EXPECT_EQ(CMNewString(mb, "text", nullptr), nullptr);
    EXPECT_EQ(memory.taken(), 0U);
}

TEST_F(LifetimeTest, TheMemoryOfARequestGoesWithIt)
{
    {
        Host::Request request(broker);
        for (int i = 0; i < 1000; ++i)
            makePath();
        EXPECT_GT(memory.taken(), 0U);
    }
    EXPECT_EQ(memory.taken(), 0U);
}

TEST_F(LifetimeTest, ReleasingAnObjectOfARequestIsHarmless)
{
    Host::Request request(broker);
    CMPIObjectPath* const path = makePath();
    CMPIString* const name = CMGetClassName(path, nullptr);
    EXPECT_EQ(CMRelease(name).rc, CMPI_RC_OK);
    EXPECT_EQ(CMRelease(path).rc, CMPI_RC_OK);
    EXPECT_EQ(CMRelease(path).rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(CMGetClassName(path, nullptr)), "Test_Class");
}

TEST_F(LifetimeTest, ACloneOutlivesItsRequestUntilItIsReleased)
{
    CMPIObjectPath* clone = nullptr;
    {
        Host::Request request(broker);
        clone = CMClone(makePath(), &rc);
        EXPECT_EQ(rc.rc, CMPI_RC_OK);
    }
    EXPECT_GT(memory.taken(), 0U);
    EXPECT_EQ(textOf(CMGetClassName(clone, nullptr)), "Test_Class");
    EXPECT_EQ(textOf(CMGetNameSpace(clone, nullptr)), "root/cimv2");
    EXPECT_EQ(textOf(CMGetKey(clone, "DeviceID", nullptr)), "fan1");
    EXPECT_EQ(CMSetNameSpace(clone, "root/interop").rc, CMPI_RC_OK);
    EXPECT_EQ(CMAddKey(clone, "More", "text", CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(CMGetKey(clone, "More", nullptr)), "text");
    EXPECT_EQ(CMRelease(clone).rc, CMPI_RC_OK);
    EXPECT_EQ(memory.taken(), 0U);
}

TEST_F(LifetimeTest, EveryKindOfObjectHasClones)
{
    CMPIString* string = nullptr;
    CMPIArray* array = nullptr;
    CMPIInstance* instance = nullptr;
    CMPIArgs* args = nullptr;
    CMPIDateTime* time = nullptr;
    CMPIContext* context = nullptr;
    CMPIError* error = nullptr;
    {
        Host::Request request(broker, {.principal = "operator"});
        string = CMClone(CMNewString(mb, "text", nullptr), nullptr);
        CMPIArray* const numbers = CMNewArray(mb, 1, CMPI_string, nullptr);
        CMSetArrayElementAt(numbers, 0, "element", CMPI_chars);
        array = CMClone(numbers, nullptr);
        CMPIInstance* const made = CMNewInstance(mb, makePath(), nullptr);
        const char* wanted[] = {"A", nullptr};
        const char* keys[] = {"K", nullptr};
        CMSetPropertyFilter(made, wanted, keys);
        CMSetProperty(made, "A", &numbers, CMPI_stringA);
        instance = CMClone(made, nullptr);
        CMPIArgs* const arguments = CMNewArgs(mb, nullptr);
        CMPIObjectPath* const path = makePath();
        CMAddArg(arguments, "Path", &path, CMPI_ref);
        args = CMClone(arguments, nullptr);
        time = CMClone(CMNewDateTimeFromChars(mb, "20240229123456.789012+060", nullptr), nullptr);
        context = CMClone(request.context().handle(), nullptr);
        CMPIError* const failure = CMNewCMPIError(
            mb, "owner", "MSG1", "text", ErrorSevHigh, Fan_Failure, CMPI_RC_ERR_FAILED, nullptr);
        failure->ft->setRecommendedActions(failure, numbers);
        error = CMClone(failure, nullptr);
    }
    {
        Host::Request later(broker);
        EXPECT_EQ(textOf(string), "text");
        EXPECT_EQ(textOf(CMGetArrayElementAt(array, 0, nullptr)), "element");
        const CMPIData property = CMGetProperty(instance, "A", nullptr);
        EXPECT_EQ(textOf(CMGetArrayElementAt(property.value.array, 0, nullptr)), "element");
        CMSetProperty(instance, "Dropped", "1", CMPI_chars);
        CMSetProperty(instance, "K", "key", CMPI_chars);
        EXPECT_EQ(CMGetPropertyCount(instance, nullptr), 2U);
        EXPECT_EQ(textOf(CMGetKey(CMGetObjectPath(instance, nullptr), "K", nullptr)), "key");
        const CMPIData argument = CMGetArg(args, "Path", nullptr);
        EXPECT_EQ(textOf(CMGetKey(argument.value.ref, "DeviceID", nullptr)), "fan1");
        EXPECT_EQ(textOf(CMGetStringFormat(time, nullptr)), "20240229123456.789012+060");
        EXPECT_EQ(textOf(CMGetContextEntry(context, CMPIPrincipal, nullptr)), "operator");
        EXPECT_EQ(textOf(error->ft->getMessage(error, nullptr)), "text");
        CMPIArray* const actions = error->ft->getRecommendedActions(error, nullptr);
        EXPECT_EQ(CMGetArrayCount(actions, nullptr), 1U);
    }
    CMRelease(string);
    CMRelease(array);
    CMRelease(instance);
    CMRelease(args);
    CMRelease(time);
    CMRelease(context);
    CMRelease(error);
    EXPECT_EQ(memory.taken(), 0U);
}

TEST_F(LifetimeTest, ACloneIsIndependentOfItsOriginal)
{
    Host::Request request(broker);
    CMPIObjectPath* const original = makePath();
    CMPIObjectPath* const clone = CMClone(original, nullptr);
    CMAddKey(original, "DeviceID", "changed", CMPI_chars);
    EXPECT_EQ(textOf(CMGetKey(clone, "DeviceID", nullptr)), "fan1");
    CMAddKey(clone, "DeviceID", "other", CMPI_chars);
    EXPECT_EQ(textOf(CMGetKey(original, "DeviceID", nullptr)), "changed");
    CMRelease(clone);
}

TEST_F(LifetimeTest, WhatAClonesPartIsPutIntoSurvivesTheClone)
{
    Host::Request request(broker);
    CMPIObjectPath* const holder = makePath();
    CMPIObjectPath* const clone = CMClone(makePath(), nullptr);
    CMPIString* const text = CMGetKey(clone, "DeviceID", nullptr).value.string;
    CMAddKey(holder, "Text", &text, CMPI_string);
    CMAddKey(holder, "Ref", &clone, CMPI_ref);
    CMRelease(clone);
    EXPECT_EQ(textOf(CMGetKey(holder, "Text", nullptr)), "fan1");
    const CMPIData reference = CMGetKey(holder, "Ref", nullptr);
    EXPECT_EQ(textOf(CMGetKey(reference.value.ref, "DeviceID", nullptr)), "fan1");
}

TEST_F(LifetimeTest, ACloneThatIsDeliveredSurvivesItsRelease)
{
    Host::Request request(broker);
    Host::CollectedResult collected;
    Host::Result result(collected);
    CMPIObjectPath* const clone = CMClone(makePath(), nullptr);
    CMReturnObjectPath(result.handle(), clone);
    CMRelease(clone);
    EXPECT_EQ(collected.paths().at(0)->key("DeviceID")->text(), "fan1");
}

TEST_F(LifetimeTest, ObjectsOfANestedRequestLiveAsLongAsTheOuterOne)
{
    Host::Request outer(broker);
    CMPIObjectPath* made = nullptr;
    {
        Host::Request inner(broker);
        EXPECT_EQ(&inner.arena(), &outer.arena());
        made = makePath();
    }
    EXPECT_EQ(textOf(CMGetKey(made, "DeviceID", nullptr)), "fan1");
    EXPECT_NE(CMNewString(mb, "still a request", nullptr), nullptr);
}

TEST_F(LifetimeTest, ANestedRequestHasItsOwnContext)
{
    Host::Request outer(broker, {.principal = "outer"});
    Host::Request inner(broker, {.principal = "inner"});
    EXPECT_EQ(textOf(CMGetContextEntry(outer.context().handle(), CMPIPrincipal, nullptr)), "outer");
    EXPECT_EQ(textOf(CMGetContextEntry(inner.context().handle(), CMPIPrincipal, nullptr)), "inner");
}

TEST_F(LifetimeTest, NamesAreKeptOncePerRequest)
{
    Host::Request request(broker);
    CMPIObjectPath* const first = makePath();
    CMPIObjectPath* const second = makePath();
    EXPECT_EQ(CMGetClassName(first, nullptr), CMGetClassName(second, nullptr));
}

TEST_F(LifetimeTest, SixtyThousandInstancesTakeMemoryInProportion)
{
    constexpr std::array names = {"DeviceID", "ElementName", "BaseUnits", "CurrentReading",
        "EnabledState", "HealthState", "SensorType", "UnitModifier"};
    const auto takenFor = [&](int count) {
        Host::Request request(broker);
        Host::CollectedResult collected;
        Host::Result result(collected);
        for (int i = 0; i < count; ++i) {
            CMPIInstance* const made = CMNewInstance(mb, makePath(), nullptr);
            for (const char* const name : names)
                CMSetProperty(made, name, &i, CMPI_sint32);
            CMReturnInstance(result.handle(), made);
        }
        EXPECT_EQ(collected.instances().size(), static_cast<std::size_t>(count));
        EXPECT_EQ(
            collected.instances().back()->property("unitmodifier")->signedInteger(), count - 1);
        return memory.taken();
    };
    const std::size_t few = takenFor(600);
    const std::size_t many = takenFor(60000);
    EXPECT_EQ(memory.taken(), 0U);
    EXPECT_LT(many, few * 100 * 2); // an arena grows by half: that much may be unused
    EXPECT_LT(many / 60000, 1536U);
}

} // namespace HostTests
