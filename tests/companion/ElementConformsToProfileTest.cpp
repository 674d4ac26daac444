// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instances of ZUMLO_SensorElementConformsToProfile, and the failures of its requests.

#include "tests/companion/ConformanceRequests.h"
#include "tests/support/FaultSweep.h"

namespace ElementConformsToProfileTests {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

TEST_F(ElementConformsToProfileTest, EnumerationHasAnAssociationForEachSensorInEitherNamespace)
{
    for (const char* const nameSpace : {interop, cimv2}) {
        const Reply reply = enumerateNames(nameSpace);
        EXPECT_EQ(reply.status.rc, CMPI_RC_OK);
        EXPECT_TRUE(reply.found.isDone());
        ASSERT_THAT(reply.found.paths(), SizeIs(2));
        const Host::ObjectPath* const first = reply.found.paths()[0];
        EXPECT_EQ(first->nameSpace(), nameSpace);
        EXPECT_EQ(end(first, "ConformantStandard"), profilePath);
        EXPECT_EQ(end(first, "ManagedElement"), cpuPath);
        EXPECT_EQ(end(reply.found.paths()[1], "ManagedElement"), fanPath);
    }
}

TEST_F(ElementConformsToProfileTest, InstancesHaveBothReferencesWhateverIsListed)
{
    const char* properties[] = {"Unheard", nullptr};
    for (const Reply& reply : {enumerate(interop, properties), references(profile(), properties)}) {
        ASSERT_THAT(reply.found.instances(), SizeIs(2));
        EXPECT_EQ(reply.found.instances()[1]->nameSpace(), interop);
        EXPECT_THAT(Testing::namesOf(reply.found.instances()[1]->properties()),
            ElementsAre("ConformantStandard", "ManagedElement"));
    }
}

TEST_F(ElementConformsToProfileTest, TheNamespacesAreThoseOfTheObjectManager)
{
    objects_.interop = "root/PG_InterOp";
    objects_.sensorNameSpace = "root/sensors";
    const Reply reply = enumerateNames("root/sensors");
    ASSERT_THAT(reply.found.paths(), SizeIs(2));
    EXPECT_EQ(end(reply.found.paths()[0], "ConformantStandard"),
        "root/PG_InterOp:ZUMLO_SensorRegisteredProfile.InstanceID=\"ZUMLO:DSP1009\"");
    EXPECT_EQ(end(reply.found.paths()[0], "ManagedElement"),
        "root/sensors:ZUMLO_NumericSensor.DeviceID=\"CPU\"");
}

TEST_F(ElementConformsToProfileTest, PathsOfUpcallsGetTheNamespaceThatTheyLack)
{
    objects_.givesNameSpaces = false;
    const Reply reply = enumerateNames(interop);
    ASSERT_THAT(reply.found.paths(), SizeIs(2));
    EXPECT_EQ(end(reply.found.paths()[1], "ConformantStandard"), profilePath);
    EXPECT_EQ(end(reply.found.paths()[1], "ManagedElement"), fanPath);
}

TEST_F(ElementConformsToProfileTest, WithoutARegistrationNothingConforms)
{
    objects_.interop = "root/elsewhere";
    for (const CMPIrc code : {CMPI_RC_ERR_INVALID_CLASS, CMPI_RC_ERR_INVALID_NAMESPACE,
             CMPI_RC_ERR_NOT_FOUND, CMPI_RC_ERR_NOT_SUPPORTED}) {
        objects_.missing = code;
        for (const Reply& reply : {enumerateNames(cimv2), associatorNames(sensor("CPU"))}) {
            EXPECT_EQ(reply.status.rc, CMPI_RC_OK);
            EXPECT_THAT(pathsIn(reply), IsEmpty());
        }
    }
}

TEST_F(ElementConformsToProfileTest, AFailureToEnumerateTheSensorsIsReported)
{
    for (const CMPIrc code : {CMPI_RC_ERR_FAILED, CMPI_RC_ERR_ACCESS_DENIED}) {
        objects_.sensorFailure = code;
        for (const Reply& reply : {enumerateNames(interop), associators(profile())}) {
            EXPECT_EQ(reply.status.rc, code);
            EXPECT_EQ(Testing::textOf(reply.status.msg),
                "the instances of ZUMLO_NumericSensor cannot be enumerated: no sensors today");
            EXPECT_FALSE(reply.found.isDone());
        }
    }
}

TEST_F(ElementConformsToProfileTest, AFailureWithoutMessageIsReportedWithItsCode)
{
    Testing::FaultyBroker faulty(broker_);
    faulty.plan({Testing::BrokerCall::enumerateInstanceNames, 1, Testing::FaultManner::errorStatus,
        CMPI_RC_ERR_ACCESS_DENIED});
    asked_ = faulty.handle();
    const Reply reply = enumerateNames(interop);
    EXPECT_EQ(reply.status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(Testing::textOf(reply.status.msg),
        "the instances of ZUMLO_SensorRegisteredProfile cannot be enumerated");
}

TEST_F(ElementConformsToProfileTest, EachNameFindsItsInstance)
{
    const Reply names = enumerateNames(interop);
    ASSERT_THAT(names.found.paths(), SizeIs(2));
    for (const Host::ObjectPath* const name : names.found.paths()) {
        const Reply reply = get(*name);
        ASSERT_THAT(reply.found.instances(), SizeIs(1));
        EXPECT_EQ(local(*reply.found.instances()[0]->property("ManagedElement")->path()),
            end(name, "ManagedElement"));
    }
}

TEST_F(ElementConformsToProfileTest, AnUnknownSensorConformsToNothing)
{
    Host::ObjectPath& unknown = path(Class, {}, interop);
    unknown.addKey("ConformantStandard", Host::Value::of(*Host::ObjectPath::of(profile())));
    unknown.addKey("ManagedElement", Host::Value::of(*Host::ObjectPath::of(sensor("none"))));
    const Reply reply = get(unknown);
    EXPECT_EQ(reply.status.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(Testing::textOf(reply.status.msg), "no such conformance");
    EXPECT_THAT(pathsIn(associatorNames(sensor("none"))), IsEmpty());
    EXPECT_THAT(pathsIn(referenceNames(sensor("none"))), IsEmpty());
}

TEST_F(ElementConformsToProfileTest, OtherKeysFindNothing)
{
    const auto find = [&](const CMPIObjectPath* standard, const char* extraKey) {
        Host::ObjectPath& target = path(Class, {}, interop);
        target.addKey("ManagedElement", Host::Value::of(*Host::ObjectPath::of(sensor("CPU"))));
        if (standard != nullptr)
            target.addKey("ConformantStandard", Host::Value::of(*Host::ObjectPath::of(standard)));
        if (extraKey != nullptr)
            target.addKey(extraKey, Host::Value::integer(CMPI_uint64, 1));
        return get(target).status.rc;
    };
    EXPECT_EQ(find(profile(), nullptr), CMPI_RC_OK);
    EXPECT_EQ(find(profile(), "Other"), CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(find(profile("ZUMLO:Other"), nullptr), CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(find(sensor("CPU"), nullptr), CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(find(nullptr, nullptr), CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(find(nullptr, "ConformantStandard"), CMPI_RC_ERR_NOT_FOUND);
}

TEST_F(ElementConformsToProfileTest, WithoutABrokerThereIsNoProvider)
{
    CMPIStatus status = {};
    EXPECT_EQ(
        SensorElementConformsToProfileProvider_Create_AssociationMI(nullptr, nullptr, &status),
        nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(ElementConformsToProfileTest, AFailingBrokerIsSurvivedAndNothingIsMadeUp)
{
    Testing::sweepFaults(broker_, [&](Testing::FaultyBroker& faulty) {
        asked_ = faulty.handle();
        for (const Reply& reply : {enumerateNames(interop), enumerate(cimv2, nullptr),
                 associatorNames(profile()), associators(profile()), associators(sensor("CPU")),
                 referenceNames(sensor("Fan"))}) {
            EXPECT_EQ(reply.found.refused(), 0U);
            EXPECT_LE(reply.found.paths().size() + reply.found.instances().size(), 2U);
            EXPECT_TRUE(reply.found.isDone() || reply.status.rc != CMPI_RC_OK);
        }
    });
}

} // namespace ElementConformsToProfileTests
