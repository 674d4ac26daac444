// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Counts have 16 bits. Where there are more sensors, an association returns as many as the
// truncated count.

#include "tests/providers/AssociationTest.h"

#include <gmock/gmock.h>

namespace ManySensorsTests {

using namespace Testing;
using ::testing::ElementsAre;

constexpr const char* elementCapabilities = "ZUMLO_SensorElementCapabilities";
constexpr const char* systemDevice = "ZUMLO_SensorSystemDevice";

// Returns sensors whose identifiers are in the order of their numbers.
std::vector<ScriptedNode> sensors(std::size_t count)
{
    std::vector<ScriptedNode> nodes;
    for (std::size_t i = 0; i < count; ++i)
        nodes.push_back({Vorn::NodeLexicon::NodeType::Tachometer, "/" + std::to_string(100000 + i),
            "F", Vorn::NodeReading{}});
    return nodes;
}

template <std::size_t count>
class ElementCapabilitiesOfMany : public AssociationTest {
protected:
    ElementCapabilitiesOfMany()
        : AssociationTest(SensorElementCapabilitiesProvider_Create_InstanceMI,
              SensorElementCapabilitiesProvider_Create_AssociationMI, sensors(count), {})
    {
    }
};
using ElementCapabilitiesOf65536SensorsTest = ElementCapabilitiesOfMany<65536>;
using ElementCapabilitiesOf65537SensorsTest = ElementCapabilitiesOfMany<65537>;

class SystemDeviceOf65537SensorsTest : public AssociationTest {
protected:
    SystemDeviceOf65537SensorsTest()
        : AssociationTest(SensorSystemDeviceProvider_Create_InstanceMI,
              SensorSystemDeviceProvider_Create_AssociationMI, sensors(65537), {"host", "guest"})
    {
    }
};

// There are 256 sensors in each of 257 systems: 65,792 pairs, which a 16-bit count truncates to
// 256.
class SystemDeviceOfManyPairsTest : public AssociationTest {
protected:
    SystemDeviceOfManyPairsTest()
        : AssociationTest(SensorSystemDeviceProvider_Create_InstanceMI,
              SensorSystemDeviceProvider_Create_AssociationMI, sensors(256), systems(257))
    {
    }

    static std::vector<std::string> systems(std::size_t count)
    {
        std::vector<std::string> names;
        for (std::size_t i = 0; i < count; ++i)
            names.push_back("S" + std::to_string(i));
        return names;
    }

    void getPair(const std::string& systemName, const std::string& deviceID)
    {
        Host::ObjectPath& ref = path(systemDevice);
        ref.addKey("GroupComponent", Host::Value::of(system(systemName)));
        ref.addKey("PartComponent", Host::Value::of(sensor(deviceID)));
        expectOk(get(ref));
        EXPECT_TRUE(answer_.isDone());
    }
};

TEST_F(SystemDeviceOfManyPairsTest, AsManyInstancesAreEnumeratedAsTheCountSays)
{
    expectOk(enumerate(path(systemDevice)));
    EXPECT_EQ(answer_.instances().size(), 256U);
}

TEST_F(SystemDeviceOfManyPairsTest, AllNamesAreEnumerated)
{
    expectOk(enumerateNames(path(systemDevice)));
    EXPECT_EQ(answer_.paths().size(), 65792U);
}

TEST_F(SystemDeviceOfManyPairsTest, TheLastInstanceOfTheCountIsFound)
{
    getPair("S0", "F:/100255");
    EXPECT_EQ(answer_.instances().size(), 1U);
}

TEST_F(SystemDeviceOfManyPairsTest, AnInstanceBeyondTheCountIsNotFound)
{
    getPair("S1", "F:/100000");
    expectNothing(true);
}

TEST_F(SystemDeviceOfManyPairsTest, ASensorHasAsManyReferencesAsTheCountOfItsSystemsSays)
{
    systems_.names = systems(65537);
    expectOk(references(sensor("F:/100000")));
    EXPECT_EQ(answer_.instances().size(), 1U);
    expectOk(associatorNames(sensor("F:/100000"))); // in the order of the enumeration
    EXPECT_EQ(answer_.paths().size(), 65537U);
}

TEST_F(ElementCapabilitiesOf65536SensorsTest, ThereAreNoPairs)
{
    expectOk(enumerateNames(path(elementCapabilities)));
    expectNothing(true);
}

TEST_F(ElementCapabilitiesOf65537SensorsTest, ThereIsOnePairAndOneFarEnd)
{
    expectOk(associatorNames(capabilities()));
    EXPECT_THAT(delivered(), ElementsAre("F:/100000"));
    expectOk(referenceNames(capabilities()));
    EXPECT_EQ(answer_.paths().size(), 2U);
    expectOk(enumerate(path(elementCapabilities)));
    EXPECT_EQ(answer_.instances().size(), 1U);
}

TEST_F(ElementCapabilitiesOf65537SensorsTest, AnInstanceBeyondTheCountIsNotFound)
{
    const auto getPair = [&](const std::string& deviceID) {
        Host::ObjectPath& ref = path(elementCapabilities);
        ref.addKey("Capabilities", Host::Value::of(capabilities()));
        ref.addKey("ManagedElement", Host::Value::of(sensor(deviceID)));
        expectOk(get(ref));
    };
    getPair("F:/100000");
    EXPECT_EQ(answer_.instances().size(), 1U);
    getPair("F:/100001");
    EXPECT_EQ(answer_.instances().size(), 1U);
}

TEST_F(SystemDeviceOf65537SensorsTest, ThereIsOnePairForEachSystem)
{
    expectOk(associatorNames(system("host")));
    EXPECT_THAT(delivered(), ElementsAre("F:/100000"));
    expectOk(enumerate(path(systemDevice)));
    EXPECT_EQ(answer_.instances().size(), 2U);
}

} // namespace ManySensorsTests
