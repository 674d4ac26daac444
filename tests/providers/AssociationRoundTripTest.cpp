// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Every path that a request returns is the source of a further request.

#include "tests/providers/AssociationTest.h"
#include "tests/providers/ClosingResult.h"

#include <gmock/gmock.h>

namespace AssociationRoundTripTests {

using namespace Testing;

// An association and the class at its far end.
struct Journey {
    const char* name;
    const char* association;
    InstanceFactory instances;
    AssociationFactory associations;
    const char* otherClass;
};

const Journey journeys[] = {
    {"elementCapabilities", "ZUMLO_SensorElementCapabilities",
        SensorElementCapabilitiesProvider_Create_InstanceMI,
        SensorElementCapabilitiesProvider_Create_AssociationMI, CapabilitiesClass},
    {"systemDevice", "ZUMLO_SensorSystemDevice", SensorSystemDeviceProvider_Create_InstanceMI,
        SensorSystemDeviceProvider_Create_AssociationMI, SystemClass},
};

class AssociationRoundTripTest : public AssociationTest,
                                 public ::testing::WithParamInterface<Journey> {
protected:
    AssociationRoundTripTest()
        : AssociationTest(
              GetParam().instances, GetParam().associations, threeSensors, {"host", "guest"})
    {
    }

    Host::ObjectPath& otherEnd()
    {
        return std::string(GetParam().otherClass) == SystemClass ? system("guest") : capabilities();
    }

    // Removes the delivered objects from the result. Returns their paths.
    std::vector<const Host::ObjectPath*> takeDelivered()
    {
        std::vector<const Host::ObjectPath*> taken = answer_.paths();
        for (const Host::Instance* const instance : answer_.instances())
            taken.push_back(&instance->objectPath());
        answer_ = Host::CollectedResult();
        return taken;
    }

    void expectFetched(const Host::ObjectPath& path)
    {
        if (path.className() == SystemClass) {
            EXPECT_EQ(
                systems_.pathTo(std::string(*path.key("Name")->text())).toText(), path.toText());
            return;
        }
        CMPIInstanceMI* const mi = providerOf(path.className());
        Host::CollectedResult found;
        Host::Result into(found);
        expectOk(mi->ft->getInstance(mi, context(), into.handle(), path.handle(), nullptr));
        ASSERT_EQ(found.instances().size(), 1U) << path.toText();
        EXPECT_EQ(found.instances()[0]->objectPath().toText(), path.toText());
    }

    void expectAllFetched(std::size_t count)
    {
        const auto paths = takeDelivered();
        EXPECT_EQ(paths.size(), count);
        for (const Host::ObjectPath* const path : paths)
            expectFetched(*path);
    }

private:
    CMPIInstanceMI* providerOf(std::string_view className)
    {
        if (className == SensorClass)
            return SensorProfileProvider_Create_InstanceMI(broker(), nullptr, nullptr);
        if (className == CapabilitiesClass)
            return SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI(
                broker(), nullptr, nullptr);
        EXPECT_EQ(className, GetParam().association);
        return instanceMI_;
    }
};

INSTANTIATE_TEST_SUITE_P(Each, AssociationRoundTripTest, ::testing::ValuesIn(journeys),
    [](const ::testing::TestParamInfo<Journey>& journey) { return journey.param.name; });

TEST_P(AssociationRoundTripTest, FromNamesAndInstancesToInstances)
{
    const std::size_t pairs = GetParam().otherClass == std::string(SystemClass) ? 6 : 3;
    expectOk(enumerateNames(path(GetParam().association)));
    expectAllFetched(pairs);
    Host::CollectedResult found;
    Host::Result into(found);
    expectOk(instanceMI_->ft->enumerateInstances(
        instanceMI_, context(), into.handle(), path(GetParam().association).handle(), nullptr));
    EXPECT_EQ(found.instances().size(), pairs);
    for (const Host::Instance* const instance : found.instances())
        expectFetched(instance->objectPath());
}

// Providers of records write the exit mark after they have closed the result.
TEST_P(AssociationRoundTripTest, RequestsForInstancesEndWithTheirExitMarkBeforeTheResultIsClosed)
{
    const Host::ObjectPath& keyless = path(GetParam().association);
    const Host::ObjectPath& keyed = path(GetParam().association, {{"Other", "x"}});
    const CMPIInstanceMIFT& functions = *instanceMI_->ft;
    using Request = std::function<void(const CMPIResult*)>;
    for (const Request& request : {
             Request([&](const CMPIResult* into) {
                 functions.enumerateInstanceNames(instanceMI_, context(), into, keyless.handle());
             }),
             Request([&](const CMPIResult* into) {
                 functions.enumerateInstances(
                     instanceMI_, context(), into, keyless.handle(), nullptr);
             }),
             Request([&](const CMPIResult* into) {
                 functions.getInstance(instanceMI_, context(), into, keyed.handle(), nullptr);
             }),
             Request([&](const CMPIResult* into) {
                 functions.getInstance(instanceMI_, context(), into, keyless.handle(), nullptr);
             }),
         }) {
        const LogCapture capture;
        const ClosingResult closing(capture);
        request(closing.handle());
        ASSERT_TRUE(closing.answer.isDone());
        EXPECT_TRUE(isExitMark(closing.linesBefore.back()));
        EXPECT_EQ(closing.linesBefore, capture.log());
    }
}

TEST_P(AssociationRoundTripTest, FromReferencesOfEitherEndToInstances)
{
    const std::size_t others = GetParam().otherClass == std::string(SystemClass) ? 2 : 1;
    expectOk(references(otherEnd()));
    expectAllFetched(3);
    expectOk(references(sensor("B:/2")));
    expectAllFetched(others);
    expectOk(referenceNames(otherEnd()));
    expectAllFetched(3);
    expectOk(referenceNames(sensor("B:/2")));
    expectAllFetched(others);
}

TEST_P(AssociationRoundTripTest, FromAssociatorsOfEitherEndToInstancesAndBack)
{
    const std::size_t others = GetParam().otherClass == std::string(SystemClass) ? 2 : 1;
    expectOk(associatorNames(otherEnd()));
    expectAllFetched(3);
    expectOk(associators(otherEnd()));
    expectAllFetched(3);
    expectOk(associatorNames(sensor("B:/2")));
    const auto farEnds = takeDelivered();
    ASSERT_EQ(farEnds.size(), others);
    for (const Host::ObjectPath* const farEnd : farEnds) {
        expectFetched(*farEnd);
        expectOk(associatorNames(*farEnd)); // and back to the sensors
        const auto sensors = takeDelivered();
        ASSERT_EQ(sensors.size(), 3U);
        EXPECT_EQ(sensors[1]->toText(), sensor("B:/2").toText());
    }
}

} // namespace AssociationRoundTripTests
