// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "companion/ComputerSystem.h"

#include "platform/text/Trim.h"
#include "tests/support/ExportedNames.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

namespace ComputerSystemTests {

using Testing::describe;
using ::testing::ElementsAre;
using Vorn::Companion::ComputerSystem;

class ComputerSystemTest : public Testing::ProviderTest {
protected:
    const Host::Instance& instance(const ComputerSystem& system, const char** properties = nullptr)
    {
        const CMPIObjectPath* const at =
            Vorn::Companion::makeSystemPath(broker(), "root/cimv2", system);
        return *Host::Instance::of(
            Vorn::Companion::makeSystemInstance(broker(), at, system, properties));
    }
};

TEST_F(ComputerSystemTest, AnInstanceHasEveryProperty)
{
    EXPECT_THAT(describe(instance({"box", "some-hash"}).properties()),
        ElementsAre("CreationClassName = string \"ZUMLO_ComputerSystem\"", "Name = string \"box\"",
            "NameFormat = string \"Other\"", "ElementName = string \"box\"",
            "Caption = string \"Computer System\"",
            "Description = string \"The computer that the sensors of this system belong to.\"",
            "OtherIdentifyingInfo = [string \"some-hash\"]",
            "IdentifyingDescriptions = [string \"Hash of the operating system's machine ID\"]",
            "Dedicated = [uint16 0]", "EnabledState = uint16 2", "RequestedState = uint16 12",
            "HealthState = uint16 5", "OperationalStatus = [uint16 2]"));
}

TEST_F(ComputerSystemTest, AMachineWithoutIdentifierHasNoIdentifyingInfo)
{
    const Host::Instance& made = instance({"box", std::nullopt});
    EXPECT_EQ(made.property("OtherIdentifyingInfo"), nullptr);
    EXPECT_EQ(made.property("IdentifyingDescriptions"), nullptr);
    EXPECT_EQ(made.properties().size(), 11U);
}

TEST_F(ComputerSystemTest, APropertyListLeavesTheKeysAndWhatItNames)
{
    const char* properties[] = {"healthstate", "Unheard", nullptr};
    EXPECT_THAT(Testing::namesOf(instance({"box", "id"}, properties).properties()),
        ElementsAre("CreationClassName", "Name", "HealthState"));
}

TEST_F(ComputerSystemTest, AnEmptyPropertyListLeavesTheKeys)
{
    const char* properties[] = {nullptr};
    EXPECT_THAT(Testing::namesOf(instance({"box", "id"}, properties).properties()),
        ElementsAre("CreationClassName", "Name"));
}

TEST_F(ComputerSystemTest, ThePathHasTheNamespaceAndTheComputerAsHost)
{
    const CMPIObjectPath* const made =
        Vorn::Companion::makeSystemPath(broker(), "root/other", {"box", std::nullopt});
    EXPECT_EQ(Host::ObjectPath::of(made)->toText(),
        "//box/root/other:ZUMLO_ComputerSystem.CreationClassName=\"ZUMLO_ComputerSystem\","
        "Name=\"box\"");
}

TEST_F(ComputerSystemTest, TheComputerHasTheSystemNameOfItsSensors)
{
    EXPECT_EQ(Vorn::Companion::thisComputerSystem().name, systemName_);
}

TEST_F(ComputerSystemTest, TheMachineIdIsTheOneThatTheSystemDerivesForThisProvider)
{
    ASSERT_NE(Testing::outputOf("systemd-id128 new"), "") << "is the package systemd installed?";
    EXPECT_EQ(Vorn::Companion::thisComputerSystem().machineId.value_or(""),
        Text::trimmed(
            Testing::outputOf("systemd-id128 machine-id --uuid "
                              "--app-specific=b3dfdcbb7a2845c0b6176da21f2a762d 2>/dev/null")));
}

} // namespace ComputerSystemTests
