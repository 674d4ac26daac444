// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/ValueMaps.h"

#include "tests/support/ShippedClasses.h"
#include "tools/cim/Units.h"

#include <gtest/gtest.h>

#include <limits>
#include <set>

namespace {

using namespace Tools;

class ValueMapsTest : public ::testing::Test {
protected:
    std::string_view meaning(
        std::string_view className, std::string_view property, std::uint64_t code) const
    {
        return meaningOf(classes_->findClass("root/cimv2", className), property, code);
    }

    std::unique_ptr<const Host::Repository> classes_ = Testing::shippedClasses();
};

TEST_F(ValueMapsTest, AreThoseOfTheClass)
{
    struct Expected {
        const char* className;
        const char* property;
        std::uint64_t code;
        const char* text;
    };
    constexpr const char* sensor = "ZUMLO_NumericSensor";
    constexpr const char* system = "ZUMLO_ComputerSystem";
    constexpr const char* capabilities = "ZUMLO_SensorEnabledLogicalElementCapabilities";
    for (const Expected& expected : {Expected{sensor, "SensorType", 5, "Tachometer"},
             Expected{sensor, "BaseUnits", 66, "Pascals"}, Expected{sensor, "RateUnits", 0, "None"},
             Expected{sensor, "EnabledState", 3, "Disabled"},
             Expected{sensor, "requestedstate", 12, "Not Applicable"},
             Expected{sensor, "HealthState", 30, "Non-recoverable error"},
             Expected{sensor, "OperationalStatus", 13, "Lost Communication"},
             Expected{sensor, "SupportedThresholds", 5, "UpperThresholdFatal"},
             Expected{sensor, "EnabledDefault", 2, "Enabled"},
             Expected{system, "Dedicated", 29, "Chassis Manager"},
             Expected{system, "ResetCapability", 5, "Not Implemented"},
             Expected{capabilities, "RequestedStatesSupported", 2, "Enabled"},
             Expected{capabilities, "RequestedStatesSupported", 11, "Reset"}})
        EXPECT_EQ(meaning(expected.className, expected.property, expected.code), expected.text)
            << expected.property;
}

TEST_F(ValueMapsTest, HaveNoTextForOtherCodesPropertiesAndClasses)
{
    constexpr const char* sensor = "ZUMLO_NumericSensor";
    EXPECT_EQ(meaning(sensor, "SensorType", 17), "");
    EXPECT_EQ(meaning(sensor, "HealthState", 6), "");
    EXPECT_EQ(meaning(sensor, "HealthState", 32768), ""); // in a range
    EXPECT_EQ(meaning(sensor, "HealthState", std::numeric_limits<std::uint64_t>::max()), "");
    EXPECT_EQ(meaning(sensor, "UnitModifier", 0), "");
    EXPECT_EQ(meaning(sensor, "Unheard", 0), "");
    EXPECT_EQ(meaning("Unheard", "HealthState", 5), "");
}

// The symbols of units are a table of their own, since they are no texts of the value map.
TEST_F(ValueMapsTest, UnitsHaveTheTextsOfBaseUnitsWhereThereIsNoSymbol)
{
    const std::set<std::uint64_t> haveSymbols = {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 20, 21, 65, 66};
    std::uint64_t code = 0;
    for (; meaning("CIM_NumericSensor", "BaseUnits", code) != ""; ++code) {
        if (!haveSymbols.contains(code)) {
            EXPECT_EQ(unitSymbol(code), meaning("CIM_NumericSensor", "BaseUnits", code));
        }
    }
    EXPECT_EQ(code, 67U);
    EXPECT_EQ(unitSymbol(code), "");
}

} // namespace
