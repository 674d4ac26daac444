// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The numeric codes by which the hardware model names its nodes and their properties.

#pragma once

namespace Vorn::NodeLexicon {

// What a sensor node measures. A sensor's type code is the number of its node type.
enum class NodeType : unsigned {
    Tachometer = 20,
    Voltage = 21,
    Temperature = 22,
};

// Readings and limits are doubles in the node's base unit, BaseUnits is one unsigned code of
// the DMTF value map CIM_NumericSensor.BaseUnits, PossibleStates a list of status codes.
enum class Properties : unsigned {
    Reading = 14,
    UpperCritical = 22,
    UpperNonCritical = 23,
    LowerCritical = 32,
    LowerNonCritical = 33,
    BaseUnits = 62,
    UpperFatal = 88,
    LowerFatal = 103,
    PossibleStates = 125,
};

} // namespace Vorn::NodeLexicon
