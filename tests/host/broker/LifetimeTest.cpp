// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The lifetimes of the objects of a request, of clones, and of their memory.

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
    EXPECT_LT(many, few * 100 * 2); // an arena grows by half, which may be unused
    EXPECT_LT(many / 60000, 1536U);
}

} // namespace HostTests
