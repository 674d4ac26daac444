// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The ways from the registration of the profile to the sensors and back.

#include "tests/companion/ConformanceRequests.h"

namespace ElementConformsToProfileTests {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

using ConformanceEndsTest = ElementConformsToProfileTest;

TEST_F(ConformanceEndsTest, TheProfileLeadsToAllSensors)
{
    EXPECT_THAT(pathsIn(associatorNames(profile())), ElementsAre(cpuPath, fanPath));
    EXPECT_THAT(pathsIn(associatorNames(profile("ZUMLO:Other"))), IsEmpty());
    EXPECT_THAT(pathsIn(referenceNames(profile())), SizeIs(2));
}

TEST_F(ConformanceEndsTest, TheProfileLeadsToInstancesWithTheListedProperties)
{
    const char* properties[] = {"DeviceID", nullptr};
    const Reply all = associators(profile());
    const Reply listed = associators(profile(), properties);
    ASSERT_THAT(all.found.instances(), SizeIs(2));
    EXPECT_EQ(Testing::property(*all.found.instances()[0], "Caption"), "string \"A sensor\"");
    ASSERT_THAT(listed.found.instances(), SizeIs(2));
    EXPECT_EQ(Testing::property(*listed.found.instances()[0], "Caption"), "absent");
    EXPECT_THAT(associators(profile("ZUMLO:Other")).found.instances(), IsEmpty());
}

TEST_F(ConformanceEndsTest, TheSensorsAreEnumeratedOnceForTheirInstances)
{
    associators(profile());
    EXPECT_THAT(objects_.calls,
        ElementsAre("root/interop:ZUMLO_SensorRegisteredProfile", "root/interop:CIM_Namespace",
            "root/cimv2:ZUMLO_NumericSensor", "root/interop:ZUMLO_NumericSensor"));
}

TEST_F(ConformanceEndsTest, ASensorLeadsToTheProfile)
{
    EXPECT_THAT(pathsIn(associatorNames(sensor("Fan"))), ElementsAre(profilePath));
    const Reply names = referenceNames(sensor("Fan"));
    ASSERT_THAT(names.found.paths(), SizeIs(1));
    EXPECT_EQ(names.found.paths()[0]->nameSpace(), cimv2);
    EXPECT_EQ(end(names.found.paths()[0], "ManagedElement"), fanPath);
}

TEST_F(ConformanceEndsTest, ASensorLeadsToTheProfilesInstanceWithTheListedProperties)
{
    const char* properties[] = {"RegisteredName", nullptr};
    const Reply reply = associators(sensor("Fan"), properties);
    ASSERT_THAT(reply.found.instances(), SizeIs(1));
    EXPECT_EQ(reply.found.instances()[0]->nameSpace(), interop);
    EXPECT_THAT(Testing::namesOf(reply.found.instances()[0]->properties()),
        ElementsAre("InstanceID", "RegisteredName"));
}

TEST_F(ConformanceEndsTest, AnotherClassLeadsNowhereWithoutAnUpcall)
{
    const auto* const system = path("ZUMLO_ComputerSystem", {{"Name", "box"}}).handle();
    EXPECT_THAT(pathsIn(associatorNames(system)), IsEmpty());
    EXPECT_THAT(pathsIn(referenceNames(system)), IsEmpty());
    EXPECT_THAT(objects_.calls, IsEmpty());
}

TEST_F(ConformanceEndsTest, FiltersThatNameTheAssociationAndItsEndsAreFollowed)
{
    for (const Filters& filters : {Filters{"zumlo_sensorelementconformstoprofile"},
             Filters{"CIM_ElementConformsToProfile"}, Filters{.resultClass = "CIM_Sensor"},
             Filters{.resultClass = "ZUMLO_NumericSensor"}, Filters{.role = "conformantstandard"},
             Filters{.resultRole = "ManagedElement"}, Filters{"", "", "", ""}})
        EXPECT_THAT(pathsIn(associatorNames(profile(), filters)), ElementsAre(cpuPath, fanPath));
    for (const Filters& filters :
        {Filters{Class, "CIM_RegisteredProfile", "ManagedElement", "ConformantStandard"},
            Filters{.resultClass = "CIM_ManagedElement"}}) {
        EXPECT_THAT(pathsIn(associatorNames(sensor("CPU"), filters)), ElementsAre(profilePath));
        EXPECT_THAT(pathsIn(referenceNames(sensor("CPU"), filters)), SizeIs(1));
    }
}

TEST_F(ConformanceEndsTest, OtherFiltersLeadNowhereWithoutAnUpcall)
{
    for (const Filters& filters : {Filters{"CIM_SystemDevice"}, Filters{.role = "ManagedElement"},
             Filters{.resultRole = "ConformantStandard"}})
        EXPECT_THAT(pathsIn(associatorNames(profile(), filters)), IsEmpty());
    for (const Filters& filters :
        {Filters{"CIM_SystemDevice"}, Filters{.role = "ConformantStandard"}})
        EXPECT_THAT(pathsIn(referenceNames(sensor("CPU"), filters)), IsEmpty());
    EXPECT_THAT(objects_.calls, IsEmpty());
}

TEST_F(ConformanceEndsTest, AResultClassThatTheFarEndIsNotOfLeadsNowhere)
{
    for (const char* const resultClass : {"CIM_Fan", "CIM_RegisteredProfile"}) {
        EXPECT_THAT(pathsIn(associatorNames(profile(), {.resultClass = resultClass})), IsEmpty());
        EXPECT_THAT(associators(profile(), nullptr, resultClass).found.instances(), IsEmpty());
    }
    EXPECT_THAT(associators(profile(), nullptr, "CIM_Sensor").found.instances(), SizeIs(2));
    EXPECT_THAT(pathsIn(associatorNames(sensor("CPU"), {.resultClass = "CIM_Sensor"})), IsEmpty());
}

} // namespace ElementConformsToProfileTests
