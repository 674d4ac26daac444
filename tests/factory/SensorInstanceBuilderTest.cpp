// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance that is built from a sensor record: its properties, their types and values.

#include "factory/SensorFactory.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

namespace SensorInstanceBuilderTests {

using namespace Vorn::SensorProfileProvider;
using namespace Testing;
using namespace ::testing;

class SensorInstanceBuilderTest : public ProviderTest {
protected:
    static Sensor fullSensor()
    {
        Sensor sensor;
        sensor.setDeviceID("CPU 1 Vcore:/board/in1");
        sensor.setElementName("CPU 1 Vcore");
        sensor.setSensorType(21);
        sensor.setCurrentState(23);
        sensor.setEnabledState(1);
        sensor.setOperationalStatus(1);
        sensor.setHealthState(23);
        sensor.setRequestedState(1);
        sensor.setPossibleStates({1, 23});
        sensor.setCurrentReading(1.25);
        sensor.setLowerThresholdNonCritical(0.9);
        sensor.setUpperThresholdNonCritical(1.2);
        sensor.setLowerThresholdCritical(0.8);
        sensor.setUpperThresholdCritical(1.5);
        sensor.setLowerThresholdFatal(0.5);
        sensor.setUpperThresholdFatal(1.75);
        sensor.setBaseUnits(5);
        return sensor;
    }

    const Host::Instance& make(
        const Sensor& sensor, const char** properties = nullptr, bool isObjPath = false)
    {
        SensorFactory factory;
        CMPIInstance* const made = factory.makeSensorInstance(
            broker(), path("ANY_Class").handle(), sensor, properties, isObjPath, &rc_);
        const Host::Instance* const instance = Host::Instance::of(made);
        if (instance == nullptr)
            throw std::runtime_error("no instance was made");
        return *instance;
    }

    std::vector<std::string> keys() const
    {
        return {"CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName"};
    }

    std::vector<std::string> namesWith(std::vector<const char*> properties, bool isObjPath = false)
    {
        properties.push_back(nullptr);
        return namesOf(make(fullSensor(), properties.data(), isObjPath).properties());
    }

    std::vector<std::string> keysAnd(std::vector<std::string> names) const
    {
        auto all = keys();
        all.insert(all.end(), names.begin(), names.end());
        return all;
    }

    CMPIStatus rc_ = {CMPI_RC_OK, nullptr};
};

TEST_F(SensorInstanceBuilderTest, AFullSensorHasAllPropertiesInOrder)
{
    EXPECT_THAT(describe(make(fullSensor()).properties()),
        ElementsAre("CreationClassName = string \"ZUMLO_NumericSensor\"",
            "DeviceID = string \"CPU 1 Vcore:/board/in1\"",
            "SystemCreationClassName = string \"ZUMLO_ComputerSystem\"",
            "SystemName = string \"" + systemName_ + "\"",
            ::testing::ContainsRegex("^Caption = string \".*CPU 1 Vcore.*\"$"),
            ::testing::ContainsRegex("^Description = string \".*CPU 1 Vcore.*\"$"),
            "Name = string \"CPU 1 Vcore\"", "ElementName = string \"CPU 1 Vcore\"",
            "CurrentState = string \"WarningHigh\"",
            "PossibleStates = [string \"Normal\", string \"WarningHigh\", string \"Normal\", "
            "string \"Warning\", string \"Non-Critical\", string \"Lower Non-Critical\", string "
            "\"Upper Non-Critical\", string \"Critical\", string \"Lower Critical\", string "
            "\"Upper Critical\", string \"Fatal\", string \"Lower Fatal\", string \"Upper "
            "Fatal\", string \"Unknown\"]",
            "BaseUnits = uint16 5", "RateUnits = uint16 0",
            "SupportedThresholds = [uint16 0, uint16 1, uint16 2, uint16 3, uint16 4, uint16 5]",
            "SettableThresholds = [uint16 0, uint16 1, uint16 2, uint16 3, uint16 4, uint16 5]",
            "SensorType = uint16 3", "EnabledState = uint16 2", "RequestedState = uint16 2",
            "HealthState = uint16 10", "Status = string \"Error\"",
            "OperationalStatus = [uint16 2]", "CurrentReading = sint32 1250",
            "UnitModifier = sint32 -3", "LowerThresholdNonCritical = sint32 900",
            "UpperThresholdNonCritical = sint32 1199", "LowerThresholdCritical = sint32 800",
            "UpperThresholdCritical = sint32 1500", "LowerThresholdFatal = sint32 500",
            "UpperThresholdFatal = sint32 1750"));
    EXPECT_EQ(rc_.rc, CMPI_RC_OK);
    EXPECT_TRUE(messages_.empty());
}

TEST_F(SensorInstanceBuilderTest, CaptionAndDescriptionAreEnglishWhereNoLanguageIsSet)
{
    const Testing::EnvironmentVariable language("LC_ALL", "C.UTF-8");
    const Host::Instance& instance = make(fullSensor());
    EXPECT_EQ(property(instance, "Caption"), "string \"Sensor CPU 1 Vcore\"");
    EXPECT_EQ(property(instance, "Description"),
        "string \"Numeric sensor CPU 1 Vcore, read from this computer's hardware\"");
}

TEST_F(SensorInstanceBuilderTest, CaptionAndDescriptionAreInTheLanguageThatIsSet)
{
    const Testing::EnvironmentVariable language("LC_ALL", "de_DE.UTF-8");
    const Host::Instance& instance = make(fullSensor());
    EXPECT_EQ(property(instance, "Caption"), "string \"Sensor CPU 1 Vcore\"");
    EXPECT_EQ(property(instance, "Description"),
        "string \"Numerischer Sensor CPU 1 Vcore, ausgelesen aus der Hardware dieses Computers\"");
}

TEST_F(SensorInstanceBuilderTest, AnEmptyRecordPublishesItsDefaults)
{
    const Host::Instance& instance = make(Sensor());
    EXPECT_EQ(property(instance, "CurrentState"), "string \"\"");
    EXPECT_EQ(property(instance, "HealthState"), "uint16 0");
    EXPECT_EQ(property(instance, "Status"), "string \"\"");
    EXPECT_EQ(property(instance, "EnabledState"), "uint16 0");
    EXPECT_EQ(property(instance, "OperationalStatus"), "[]");
    EXPECT_EQ(property(instance, "CurrentReading"), "sint32 0");
    EXPECT_EQ(property(instance, "UnitModifier"), "sint32 0");
    EXPECT_EQ(instance.property("PossibleStates")->array()->elements().size(), 12U);
    for (const char* const threshold :
        {"LowerThresholdNonCritical", "UpperThresholdNonCritical", "LowerThresholdCritical",
            "UpperThresholdCritical", "LowerThresholdFatal", "UpperThresholdFatal"})
        EXPECT_EQ(property(instance, threshold), "absent") << threshold;
}

TEST_F(SensorInstanceBuilderTest, AThresholdThatScalesToZeroIsLeftOut)
{
    Sensor sensor = fullSensor();
    sensor.setUpperThresholdFatal(0.0004);
    EXPECT_EQ(property(make(sensor), "UpperThresholdFatal"), "absent");
}

TEST_F(SensorInstanceBuilderTest, ANegativeThresholdIsPublished)
{
    Sensor sensor = fullSensor();
    sensor.setLowerThresholdFatal(-0.5);
    EXPECT_EQ(property(make(sensor), "LowerThresholdFatal"), "sint32 -500");
}

TEST_F(SensorInstanceBuilderTest, TheStoredRecordIsUntouched)
{
    Sensor sensor = fullSensor();
    make(sensor);
    EXPECT_EQ(sensor.getSupportedThresholds().size(), 6U);
    EXPECT_EQ(sensor.getPossibleStates().size(), 14U);
}

TEST_F(SensorInstanceBuilderTest, AnObjectPathNeedsTheKeysAlone)
{
    EXPECT_EQ(namesOf(make(fullSensor(), nullptr, true).properties()), keys());
}

TEST_F(SensorInstanceBuilderTest, APropertyListDecidesWhateverTheObjectPathFlagSays)
{
    EXPECT_EQ(namesWith({"Name"}, true), keysAnd({"Name"}));
    EXPECT_EQ(namesWith({"Name"}, false), keysAnd({"Name"}));
}

TEST_F(SensorInstanceBuilderTest, AnEmptyListSelectsTheKeysAlone)
{
    EXPECT_EQ(namesWith({}), keys());
}

TEST_F(SensorInstanceBuilderTest, EachPropertyIsSelectedByItsName)
{
    for (const char* const name :
        {"Caption", "Description", "Name", "ElementName", "CurrentState", "PossibleStates",
            "BaseUnits", "RateUnits", "SupportedThresholds", "SettableThresholds", "SensorType",
            "EnabledState", "RequestedState", "OperationalStatus", "CurrentReading", "UnitModifier",
            "LowerThresholdNonCritical", "UpperThresholdNonCritical", "LowerThresholdCritical",
            "UpperThresholdCritical", "LowerThresholdFatal", "UpperThresholdFatal"})
        EXPECT_EQ(namesWith({name}), keysAnd({name}));
}

// The broker's filter has the list as well: the broker drops Status unless it is listed.
TEST_F(SensorInstanceBuilderTest, StatusTravelsWithHealthState)
{
    EXPECT_EQ(namesWith({"Status"}), keys());
    EXPECT_EQ(namesWith({"HealthState", "Status"}), keysAnd({"HealthState", "Status"}));
}

TEST_F(SensorInstanceBuilderTest, NamesAreComparedLetterForLetter)
{
    EXPECT_EQ(namesWith({"healthstate"}), keys());
}

TEST_F(SensorInstanceBuilderTest, KeysAreSetAlsoWhenTheyAreListed)
{
    EXPECT_EQ(namesWith({"DeviceID", "Name"}), keysAnd({"Name"}));
}

TEST_F(SensorInstanceBuilderTest, ThePathHasTheRequestsNamespaceAndThisSystemAsHost)
{
    SensorFactory factory;
    const Host::ObjectPath& ref = path("ANY_Class", {}, "root/other");
    const Host::Instance* const instance = Host::Instance::of(
        factory.makeSensorInstance(broker(), ref.handle(), fullSensor(), nullptr, false, &rc_));
    ASSERT_NE(instance, nullptr);
    const Host::ObjectPath& made = instance->objectPath();
    EXPECT_EQ(made.nameSpace(), "root/other");
    EXPECT_EQ(made.host(), systemName_);
    EXPECT_EQ(made.className(), "ZUMLO_NumericSensor");
    EXPECT_EQ(namesOf(made.keys()), keys());
}

TEST_F(SensorInstanceBuilderTest, AUtf8NameComesOutWholeInCaptionAndDescription)
{
    Sensor sensor = fullSensor();
    sensor.setElementName("Lüfter №1 — 風扇 🌀");
    const Host::Instance& instance = make(sensor);
    EXPECT_THAT(property(instance, "Caption"), ::testing::HasSubstr("Lüfter №1 — 風扇 🌀"));
    EXPECT_THAT(property(instance, "Description"), ::testing::HasSubstr("Lüfter №1 — 風扇 🌀"));
}

TEST_F(SensorInstanceBuilderTest, ANameThatLooksLikeAFormatIsTakenAsItIs)
{
    Sensor sensor = fullSensor();
    sensor.setElementName("100%s%n %d");
    EXPECT_THAT(property(make(sensor), "Caption"), ::testing::HasSubstr("100%s%n %d"));
}

TEST_F(SensorInstanceBuilderTest, ALongNameIsCutInCaptionButNotInName)
{
    Sensor sensor = fullSensor();
    std::string name;
    for (int i = 0; i < 600; ++i)
        name += "ü";
    sensor.setElementName(name);
    const Host::Instance& instance = make(sensor);
    // 511 characters, of which "Sensor " takes seven.
    EXPECT_EQ(property(instance, "Caption"),
        "string \"Sensor " + name.substr(0, 504 * std::string_view("ü").size()) + "\"");
    EXPECT_EQ(property(instance, "Name"), "string \"" + name + "\"");
}

TEST_F(SensorInstanceBuilderTest, ALongNameOfAsciiIsCutAtTheSameLength)
{
    Sensor sensor = fullSensor();
    for (const std::size_t length : {503U, 504U, 505U, 600U}) {
        sensor.setElementName(std::string(length, 'x'));
        EXPECT_EQ(property(make(sensor), "Caption"),
            "string \"Sensor " + std::string(std::min<std::size_t>(length, 504), 'x') + "\"");
    }
}

TEST_F(SensorInstanceBuilderTest, ExactlyAFull16BitCountOfLabelsIsNoProperty)
{
    Sensor sensor = fullSensor();
    sensor.setPossibleStates(std::vector<unsigned>(65536 - 12, 1));
    EXPECT_EQ(property(make(sensor), "PossibleStates"), "absent");
    sensor.setPossibleStates(std::vector<unsigned>(65536 - 12 + 2, 1));
    EXPECT_EQ(property(make(sensor), "PossibleStates"), "[string \"Normal\", string \"Normal\"]");
}

} // namespace SensorInstanceBuilderTests
