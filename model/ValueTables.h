// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Maps the hardware model's codes to CIM values. The numbers on the right are those of the DMTF
// value maps of CIM_NumericSensor, CIM_EnabledLogicalElement and CIM_ManagedSystemElement.
//
// A node status has deliberately different meanings in different tables: 20 is an unknown state,
// degraded health and a predictive failure; 21 to 26 are states and health, but an unknown
// operational status.

#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

namespace Vorn::SensorProfileProvider {

template <typename Value>
struct Row {
    unsigned code;
    Value value;
};

template <typename Value, std::size_t Rows>
struct ValueTable {
    std::array<Row<Value>, Rows> rows;
    Value otherwise;

    constexpr const Value& operator[](unsigned code) const
    {
        for (const Row<Value>& row : rows)
            if (row.code == code)
                return row.value;
        return otherwise;
    }
};

// The published type of a sensor type code, and the scale of its readings and thresholds.
struct TypeAndScale {
    std::uint16_t sensorType;
    double multiplier;
    int unitModifier; // the power of ten that undoes the multiplier
    bool isKnown;
};

struct Health {
    std::uint16_t state;
    const char* status; // published as the property Status
};

// clang-format off
inline constexpr ValueTable<TypeAndScale, 3> sensorTypes = {{{
    {20, {5, 1.0, 0, true}},     // Tachometer
    {21, {3, 1000.0, -3, true}}, // Voltage, published in millivolts
    {22, {2, 1.0, 0, true}},     // Temperature
}}, {0, 1.0, 0, false}};         // Unknown

inline constexpr ValueTable<std::uint16_t, 4> enabledStates = {{{
    {0, 0},  // Unknown
    {1, 2},  // Enabled
    {12, 6}, // Enabled but Offline
    {16, 3}, // Disabled
}}, 5};      // Not Applicable

inline constexpr ValueTable<std::uint16_t, 7> requestedStates = {{{
    {0, 0},  // Unknown
    {1, 2},  // Enabled
    {3, 4},  // Shut Down
    {8, 9},  // Quiesce
    {9, 10}, // Reboot
    {12, 4}, // Shut Down, too
    {16, 3}, // Disabled
}}, 12};     // Not Applicable

inline constexpr ValueTable<Health, 8> healthStates = {{{
    {0, {0, "UnKnown"}},
    {20, {10, "Error"}}, // Degraded/Warning
    {21, {10, "Error"}},
    {22, {10, "Error"}},
    {23, {10, "Error"}},
    {24, {25, "Error"}}, // Critical failure
    {25, {25, "Error"}},
    {26, {25, "Error"}},
}}, {5, "OK"}};

inline constexpr ValueTable<const char*, 9> stateLabels = {{{
    {1, "Normal"},
    {12, "Offline"},
    {16, "Disabled"},
    {21, "Warning"},
    {22, "WarningLow"},
    {23, "WarningHigh"},
    {24, "Critical"},
    {25, "CriticalLow"},
    {26, "CriticalHigh"},
}}, "Unknown"};

inline constexpr ValueTable<std::uint16_t, 9> operationalStatuses = {{{
    {0, 0},   // Unknown
    {1, 2},   // OK
    {2, 8},   // Starting
    {3, 9},   // Stopping
    {8, 15},  // Dormant
    {10, 10}, // Stopped
    {13, 13}, // Lost Communication
    {17, 12}, // No Contact
    {20, 5},  // Predictive Failure
}}, 0};       // Unknown
// clang-format on

// The labels that are published for every sensor after those of its node.
inline constexpr std::array<const char*, 12> fixedStateLabels = {"Normal", "Warning",
    "Non-Critical", "Lower Non-Critical", "Upper Non-Critical", "Critical", "Lower Critical",
    "Upper Critical", "Fatal", "Lower Fatal", "Upper Fatal", "Unknown"};

// LowerThresholdNonCritical, UpperThresholdNonCritical, LowerThresholdCritical,
// UpperThresholdCritical, LowerThresholdFatal, UpperThresholdFatal.
inline constexpr std::array<std::uint16_t, 6> thresholdCodes = {0, 1, 2, 3, 4, 5};

} // namespace Vorn::SensorProfileProvider
