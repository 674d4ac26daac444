// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The shipped classes.

#include "host/repository/Compiler.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Texts.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmpidt.h>

namespace ShippedSchemaTests {

using ::testing::ElementsAre;

constexpr const char* cimv2 = "root/cimv2";
constexpr const char* interop = "root/interop";
const std::filesystem::path folder = SENSOR_PROFILE_SOURCE_DIR "/schema";

class ShippedSchemaTest : public ::testing::Test {
protected:
    static std::unique_ptr<const Host::Repository> compileAll()
    {
        Host::Compiler compiler;
        compiler.compileFile(folder / "host.mof", "root/other");
        return std::move(compiler).finish();
    }

    std::vector<std::string> ancestors(const char* className, const char* nameSpace = cimv2) const
    {
        std::vector<std::string> names;
        const auto* declared = repository_->findClass(nameSpace, className);
        while ((declared = declared->superclass) != nullptr)
            names.push_back(declared->name);
        return names;
    }

    std::vector<std::string> references(const char* className) const
    {
        std::vector<std::string> found;
        for (const auto& each : repository_->referencesOf(cimv2, className))
            found.push_back(each.name + " -> " + each.className);
        return found;
    }

    const std::vector<std::string>& keys(const char* className, const char* nameSpace = cimv2) const
    {
        return *repository_->keysOf(nameSpace, className);
    }

    std::unique_ptr<const Host::Repository> repository_ = compileAll();
};

TEST_F(ShippedSchemaTest, SensorsAreNumericSensors)
{
    EXPECT_THAT(ancestors("ZUMLO_NumericSensor"),
        ElementsAre("CIM_NumericSensor", "CIM_Sensor", "CIM_LogicalDevice",
            "CIM_EnabledLogicalElement", "CIM_LogicalElement", "CIM_ManagedSystemElement",
            "CIM_ManagedElement"));
    EXPECT_THAT(keys("ZUMLO_NumericSensor"),
        ElementsAre("SystemCreationClassName", "SystemName", "CreationClassName", "DeviceID"));
}

TEST_F(ShippedSchemaTest, CapabilitiesAreNamedByAnInstanceId)
{
    EXPECT_THAT(ancestors("ZUMLO_SensorEnabledLogicalElementCapabilities"),
        ElementsAre(
            "CIM_EnabledLogicalElementCapabilities", "CIM_Capabilities", "CIM_ManagedElement"));
    EXPECT_THAT(keys("ZUMLO_SensorEnabledLogicalElementCapabilities"), ElementsAre("InstanceID"));
}

TEST_F(ShippedSchemaTest, TheComputerSystemIsNamedByClassAndName)
{
    EXPECT_THAT(ancestors("ZUMLO_ComputerSystem"),
        ElementsAre("CIM_ComputerSystem", "CIM_System", "CIM_EnabledLogicalElement",
            "CIM_LogicalElement", "CIM_ManagedSystemElement", "CIM_ManagedElement"));
    EXPECT_THAT(keys("ZUMLO_ComputerSystem"), ElementsAre("CreationClassName", "Name"));
}

TEST_F(ShippedSchemaTest, AssociationsAreKeyedByTheirReferences)
{
    EXPECT_THAT(
        ancestors("ZUMLO_SensorElementCapabilities"), ElementsAre("CIM_ElementCapabilities"));
    EXPECT_THAT(
        keys("ZUMLO_SensorElementCapabilities"), ElementsAre("ManagedElement", "Capabilities"));
    EXPECT_THAT(references("ZUMLO_SensorElementCapabilities"),
        ElementsAre("ManagedElement -> ZUMLO_NumericSensor",
            "Capabilities -> ZUMLO_SensorEnabledLogicalElementCapabilities"));
    EXPECT_THAT(ancestors("ZUMLO_SensorSystemDevice"),
        ElementsAre("CIM_SystemDevice", "CIM_SystemComponent", "CIM_Component"));
    EXPECT_THAT(keys("ZUMLO_SensorSystemDevice"), ElementsAre("GroupComponent", "PartComponent"));
    EXPECT_THAT(references("ZUMLO_SensorSystemDevice"),
        ElementsAre(
            "GroupComponent -> ZUMLO_ComputerSystem", "PartComponent -> ZUMLO_NumericSensor"));
    EXPECT_TRUE(repository_->findClass(cimv2, "ZUMLO_SensorSystemDevice")->isAssociation);
    EXPECT_FALSE(repository_->findClass(cimv2, "ZUMLO_NumericSensor")->isAssociation);
}

TEST_F(ShippedSchemaTest, InteropDescribesTheObjectManager)
{
    EXPECT_THAT(keys("CIM_Namespace", interop),
        ElementsAre("SystemCreationClassName", "SystemName", "ObjectManagerCreationClassName",
            "ObjectManagerName", "CreationClassName", "Name"));
    EXPECT_THAT(keys("CIM_ObjectManager", interop),
        ElementsAre("SystemCreationClassName", "SystemName", "CreationClassName", "Name"));
    EXPECT_THAT(ancestors("CIM_ObjectManager", interop),
        ElementsAre("CIM_WBEMService", "CIM_Service", "CIM_EnabledLogicalElement",
            "CIM_LogicalElement", "CIM_ManagedSystemElement", "CIM_ManagedElement"));
}

TEST_F(ShippedSchemaTest, TheProfilesAssociationIsInBothNamespacesAndItsRegistrationInOne)
{
    EXPECT_THAT(keys("ZUMLO_SensorRegisteredProfile", interop), ElementsAre("InstanceID"));
    EXPECT_EQ(repository_->findClass(cimv2, "ZUMLO_SensorRegisteredProfile"), nullptr);
    for (const char* const nameSpace : {cimv2, interop})
        EXPECT_THAT(keys("ZUMLO_SensorElementConformsToProfile", nameSpace),
            ElementsAre("ConformantStandard", "ManagedElement"));
    EXPECT_THAT(references("ZUMLO_SensorElementConformsToProfile"),
        ElementsAre(
            "ConformantStandard -> CIM_RegisteredProfile", "ManagedElement -> CIM_ManagedElement"));
}

// Other object managers compile one file after the other on top of the classes that they have.
TEST_F(ShippedSchemaTest, TheFilesCompileOneByOneToo)
{
    Host::Compiler compiler;
    compiler.compileFile(folder / "qualifiers.mof", cimv2);
    compiler.compileFile(folder / "cim-ancestors.mof", cimv2);
    compiler.compileFile(folder / "sensor-profile-computer-system.mof", cimv2);
    compiler.compileFile(folder / "sensor-profile.mof", cimv2);
    compiler.compileFile(folder / "sensor-profile-conformance.mof", cimv2);
    const auto repository = std::move(compiler).finish();
    EXPECT_NE(repository->findClass(cimv2, "ZUMLO_SensorSystemDevice"), nullptr);
}

// docs/operations.md has administrators concatenate the classes that an object manager may lack.
TEST_F(ShippedSchemaTest, TheAncestorsCompileAsOneFile)
{
    std::string all;
    for (const char* const name : {"qualifiers.mof", "cim-core.mof", "cim-ancestors.mof"})
        for (const std::string& line : Testing::linesOf(Testing::contentOf(folder / name)))
            if (!line.starts_with("#pragma include"))
                all += line + '\n';
    const Testing::TemporaryFolder files;
    Host::Compiler compiler;
    compiler.compileFile(files.write("10-cim.mof", all), cimv2);
    compiler.compileFile(folder / "sensor-profile-computer-system.mof", cimv2);
    compiler.compileFile(folder / "sensor-profile.mof", cimv2);
    compiler.compileFile(folder / "sensor-profile-conformance.mof", cimv2);
    const auto repository = std::move(compiler).finish();
    EXPECT_NE(repository->findClass(cimv2, "ZUMLO_SensorSystemDevice"), nullptr);
}

TEST_F(ShippedSchemaTest, EveryElementIsDescribed)
{
    for (const auto& nameSpace : repository_->namespaces())
        for (const auto& declared : nameSpace->classes()) {
            EXPECT_NE(Host::qualifierText(declared->qualifiers, "Description"), "")
                << declared->name;
            for (const auto& property : declared->properties)
                EXPECT_NE(Host::qualifierText(property->qualifiers, "Description"), "")
                    << declared->name << "." << property->name;
        }
}

TEST_F(ShippedSchemaTest, EveryMappedValueHasItsText)
{
    int maps = 0;
    for (const auto& nameSpace : repository_->namespaces())
        for (const auto& declared : nameSpace->classes())
            for (const auto& property : declared->properties) {
                const auto* const map = Host::findQualifier(property->qualifiers, "ValueMap");
                const auto* const texts = Host::findQualifier(property->qualifiers, "Values");
                if (texts == nullptr)
                    continue;
                ++maps;
                ASSERT_NE(map, nullptr) << declared->name << "." << property->name;
                EXPECT_EQ(std::get<std::vector<Host::Scalar>>(map->value).size(),
                    std::get<std::vector<Host::Scalar>>(texts->value).size())
                    << declared->name << "." << property->name;
            }
    EXPECT_GT(maps, 0);
}

TEST_F(ShippedSchemaTest, MappedPropertiesExist)
{
    for (const auto& nameSpace : repository_->namespaces())
        for (const auto& declared : nameSpace->classes())
            for (const auto& property : declared->properties) {
                const auto* const others =
                    Host::findQualifier(property->qualifiers, "ModelCorrespondence");
                if (others == nullptr)
                    continue;
                for (const auto& other : std::get<std::vector<Host::Scalar>>(others->value)) {
                    const std::string& text = std::get<std::string>(other);
                    const auto dot = text.find('.');
                    const auto* const owner = nameSpace->findClass(text.substr(0, dot));
                    ASSERT_NE(owner, nullptr) << text;
                    EXPECT_NE(owner->property(text.substr(dot + 1)), nullptr) << text;
                }
            }
}

} // namespace ShippedSchemaTests
