// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Tests of the requests of ZUMLO_SensorElementConformsToProfile.

#include "tests/companion/Factory.h"
#include "tests/companion/ScriptedObjects.h"
#include "tests/support/ClassTable.h"
#include "tests/support/FaultSweep.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

namespace ElementConformsToProfileTests {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Testing::ScriptedObjects;
using ::testing::SizeIs;

constexpr const char* Class = "ZUMLO_SensorElementConformsToProfile";
constexpr const char* interop = "root/interop";
constexpr const char* cimv2 = "root/cimv2";

struct Filters {
    const char* associationClass = nullptr;
    const char* resultClass = nullptr;
    const char* role = nullptr;
    const char* resultRole = nullptr;
};

struct Reply {
    CMPIStatus status = {};
    Host::CollectedResult found;
};

// Requests whose up-calls the scripted objects answer.
class ElementConformsToProfileTest : public Testing::ProviderTest {
protected:
    ElementConformsToProfileTest()
    {
        broker_.setUpcalls(&objects_);
        classes_.add(Class, {}, "CIM_ElementConformsToProfile");
        classes_.add(ScriptedObjects::ProfileClass, {}, "CIM_RegisteredProfile");
        classes_.add("CIM_RegisteredProfile", {}, "CIM_ManagedElement");
        classes_.add(ScriptedObjects::SensorClass, {}, "CIM_NumericSensor");
        classes_.add("CIM_NumericSensor", {}, "CIM_Sensor");
        broker_.setClassInformation(&classes_);
    }

    const CMPIObjectPath* profile(const char* id = "ZUMLO:DSP1009")
    {
        return path(ScriptedObjects::ProfileClass, {{"InstanceID", id}}, interop).handle();
    }

    const CMPIObjectPath* sensor(const char* id)
    {
        return path(ScriptedObjects::SensorClass, {{"DeviceID", id}}, cimv2).handle();
    }

    const CMPIObjectPath* classIn(const char* nameSpace)
    {
        return path(Class, {}, nameSpace).handle();
    }

    // Returns what `ask(functions, record, result)` delivers.
    template <typename Record, typename Ask>
    static Reply replyOf(Record* mi, const Ask& ask)
    {
        Reply reply;
        Host::Result collecting(reply.found);
        reply.status = ask(*mi->ft, mi, collecting.handle());
        return reply;
    }

    template <typename Ask>
    Reply instances(const Ask& ask) const
    {
        return replyOf(
            SensorElementConformsToProfileProvider_Create_InstanceMI(asked_, nullptr, nullptr),
            ask);
    }

    template <typename Ask>
    Reply associations(const Ask& ask) const
    {
        return replyOf(
            SensorElementConformsToProfileProvider_Create_AssociationMI(asked_, nullptr, nullptr),
            ask);
    }

    Reply enumerateNames(const char* nameSpace)
    {
        return instances([&](auto& ft, auto* mi, auto* result) {
            return ft.enumerateInstanceNames(mi, context(), result, classIn(nameSpace));
        });
    }

    Reply enumerate(const char* nameSpace, const char** properties)
    {
        return instances([&](auto& ft, auto* mi, auto* result) {
            return ft.enumerateInstances(mi, context(), result, classIn(nameSpace), properties);
        });
    }

    Reply get(const Host::ObjectPath& target)
    {
        return instances([&](auto& ft, auto* mi, auto* result) {
            return ft.getInstance(mi, context(), result, target.handle(), nullptr);
        });
    }

    Reply associatorNames(const CMPIObjectPath* source, const Filters& filters = {})
    {
        return associations([&](auto& ft, auto* mi, auto* result) {
            return ft.associatorNames(mi, context(), result, source, filters.associationClass,
                filters.resultClass, filters.role, filters.resultRole);
        });
    }

    Reply associators(const CMPIObjectPath* source, const char** properties = nullptr,
        const char* resultClass = nullptr)
    {
        return associations([&](auto& ft, auto* mi, auto* result) {
            return ft.associators(
                mi, context(), result, source, nullptr, resultClass, nullptr, nullptr, properties);
        });
    }

    Reply referenceNames(const CMPIObjectPath* source, const Filters& filters = {})
    {
        return associations([&](auto& ft, auto* mi, auto* result) {
            return ft.referenceNames(
                mi, context(), result, source, filters.associationClass, filters.role);
        });
    }

    Reply references(const CMPIObjectPath* source, const char** properties)
    {
        return associations([&](auto& ft, auto* mi, auto* result) {
            return ft.references(mi, context(), result, source, nullptr, nullptr, properties);
        });
    }

    // Returns the returned paths without their hosts.
    static std::vector<std::string> pathsIn(const Reply& reply)
    {
        std::vector<std::string> texts;
        for (const Host::ObjectPath* const each : reply.found.paths())
            texts.push_back(local(*each));
        return texts;
    }

    static std::string local(const Host::ObjectPath& path)
    {
        const std::string text = path.toText();
        return path.host().empty() ? text : text.substr(path.host().size() + 3);
    }

    static std::string end(const Host::ObjectPath* association, const char* role)
    {
        return local(*association->key(role)->path());
    }

    Testing::ClassTable classes_;
    ScriptedObjects objects_;
    const CMPIBroker* asked_ = broker();
};

constexpr const char* profilePath =
    "root/interop:ZUMLO_SensorRegisteredProfile.InstanceID=\"ZUMLO:DSP1009\"";
constexpr const char* cpuPath = "root/cimv2:ZUMLO_NumericSensor.DeviceID=\"CPU\"";
constexpr const char* fanPath = "root/cimv2:ZUMLO_NumericSensor.DeviceID=\"Fan\"";

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

TEST_F(ElementConformsToProfileTest, TheProfileLeadsToAllSensors)
{
    EXPECT_THAT(pathsIn(associatorNames(profile())), ElementsAre(cpuPath, fanPath));
    EXPECT_THAT(pathsIn(associatorNames(profile("ZUMLO:Other"))), IsEmpty());
    EXPECT_THAT(pathsIn(referenceNames(profile())), SizeIs(2));
}

TEST_F(ElementConformsToProfileTest, TheProfileLeadsToInstancesWithTheListedProperties)
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

TEST_F(ElementConformsToProfileTest, TheSensorsAreEnumeratedOnceForTheirInstances)
{
    associators(profile());
    EXPECT_THAT(objects_.calls,
        ElementsAre("root/interop:ZUMLO_SensorRegisteredProfile", "root/interop:CIM_Namespace",
            "root/cimv2:ZUMLO_NumericSensor", "root/interop:ZUMLO_NumericSensor"));
}

TEST_F(ElementConformsToProfileTest, ASensorLeadsToTheProfile)
{
    EXPECT_THAT(pathsIn(associatorNames(sensor("Fan"))), ElementsAre(profilePath));
    const Reply names = referenceNames(sensor("Fan"));
    ASSERT_THAT(names.found.paths(), SizeIs(1));
    EXPECT_EQ(names.found.paths()[0]->nameSpace(), cimv2);
    EXPECT_EQ(end(names.found.paths()[0], "ManagedElement"), fanPath);
}

TEST_F(ElementConformsToProfileTest, ASensorLeadsToTheProfilesInstanceWithTheListedProperties)
{
    const char* properties[] = {"RegisteredName", nullptr};
    const Reply reply = associators(sensor("Fan"), properties);
    ASSERT_THAT(reply.found.instances(), SizeIs(1));
    EXPECT_EQ(reply.found.instances()[0]->nameSpace(), interop);
    EXPECT_THAT(Testing::namesOf(reply.found.instances()[0]->properties()),
        ElementsAre("InstanceID", "RegisteredName"));
}

TEST_F(ElementConformsToProfileTest, AnotherClassLeadsNowhereWithoutAnUpcall)
{
    const auto* const system = path("ZUMLO_ComputerSystem", {{"Name", "box"}}).handle();
    EXPECT_THAT(pathsIn(associatorNames(system)), IsEmpty());
    EXPECT_THAT(pathsIn(referenceNames(system)), IsEmpty());
    EXPECT_THAT(objects_.calls, IsEmpty());
}

TEST_F(ElementConformsToProfileTest, FiltersThatNameTheAssociationAndItsEndsAreFollowed)
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

TEST_F(ElementConformsToProfileTest, OtherFiltersLeadNowhereWithoutAnUpcall)
{
    for (const Filters& filters : {Filters{"CIM_SystemDevice"}, Filters{.role = "ManagedElement"},
             Filters{.resultRole = "ConformantStandard"}})
        EXPECT_THAT(pathsIn(associatorNames(profile(), filters)), IsEmpty());
    for (const Filters& filters :
        {Filters{"CIM_SystemDevice"}, Filters{.role = "ConformantStandard"}})
        EXPECT_THAT(pathsIn(referenceNames(sensor("CPU"), filters)), IsEmpty());
    EXPECT_THAT(objects_.calls, IsEmpty());
}

TEST_F(ElementConformsToProfileTest, AResultClassThatTheFarEndIsNotOfLeadsNowhere)
{
    for (const char* const resultClass : {"CIM_Fan", "CIM_RegisteredProfile"}) {
        EXPECT_THAT(pathsIn(associatorNames(profile(), {.resultClass = resultClass})), IsEmpty());
        EXPECT_THAT(associators(profile(), nullptr, resultClass).found.instances(), IsEmpty());
    }
    EXPECT_THAT(associators(profile(), nullptr, "CIM_Sensor").found.instances(), SizeIs(2));
    EXPECT_THAT(pathsIn(associatorNames(sensor("CPU"), {.resultClass = "CIM_Sensor"})), IsEmpty());
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
