// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/text/Trim.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace Vorn::SensorProfileProvider {

// Holds one numeric sensor in CIM form. Setters take the codes of the hardware model (a sensor
// type, a node status) and store the numbers of the DMTF value maps of CIM_NumericSensor and its
// ancestors; each getter returns the value of the CIM property of the same name.
//
// Readings and thresholds are scaled to whole units of 10^UnitModifier. setSensorType() sets the
// scale, so it is called before their setters.
//
// Some getters change the record: those that append extend their list at every call, and
// getRateUnits() resets the rate. Callers that need the plain lists call them once on a copy.
//
// A value type for one thread. Functions throw only std::bad_alloc.
class Sensor {
public:
    Sensor();

    // The identifier as getDeviceID() returns it, valid until the record changes.
    std::string_view deviceID() const { return Text::trimmed(deviceID_, " \t"); }

    std::string getDeviceID() const;    // without leading and trailing blanks
    std::string getElementName() const; // without leading and trailing blanks
    std::string getCurrentState() const { return currentState_; }
    std::string getHealthStatus() const { return healthStatus_; } // property Status
    std::vector<std::string> getPossibleStates();                 // appends the twelve fixed labels
    std::uint16_t getBaseUnits() const { return baseUnits_; }
    std::uint16_t getRateUnits(); // always 0, which it also stores
    std::int32_t getUnitModifier() const { return unitModifier_; }
    std::uint16_t getSensorType() const { return sensorType_; }
    std::uint16_t getEnabledState() const { return enabledState_; }
    std::uint16_t getRequestedState() const { return requestedState_; }
    std::uint16_t getHealthState() const { return healthState_; }
    std::int32_t getCurrentReading() const { return currentReading_; }
    std::int32_t getLowerThresholdNonCritical() const { return lowerThresholdNonCritical_; }
    std::int32_t getUpperThresholdNonCritical() const { return upperThresholdNonCritical_; }
    std::int32_t getLowerThresholdCritical() const { return lowerThresholdCritical_; }
    std::int32_t getUpperThresholdCritical() const { return upperThresholdCritical_; }
    std::int32_t getLowerThresholdFatal() const { return lowerThresholdFatal_; }
    std::int32_t getUpperThresholdFatal() const { return upperThresholdFatal_; }
    std::vector<std::uint16_t> getOperationalStatus() const
    {
        return {operationalStatus_.begin(), operationalStatus_.end()};
    }
    std::vector<std::uint16_t> getSupportedThresholds(); // appends 0 to 5
    std::vector<std::uint16_t> getSettableThresholds();  // appends 0 to 5

    // Each setter returns whether it accepts the value. Only an empty device identifier, an empty
    // name and a zero rate are refused; a refused value is stored nevertheless.
    bool setDeviceID(std::string deviceID);
    bool setElementName(std::string elementName);
    bool setBaseUnits(unsigned code);
    bool setRateUnits(unsigned code);
    bool setUnitModifier(int powerOfTen);
    bool setSensorType(unsigned sensorType);
    bool setEnabledState(unsigned nodeStatus);
    bool setRequestedState(unsigned code);
    bool setHealthState(unsigned nodeStatus); // also the health status
    bool setCurrentState(unsigned nodeStatus);
    bool setOperationalStatus(unsigned nodeStatus);                    // appends
    bool setPossibleStates(const std::vector<unsigned>& nodeStatuses); // replaces
    bool setCurrentReading(double value);
    bool setLowerThresholdNonCritical(double value);
    bool setUpperThresholdNonCritical(double value);
    bool setLowerThresholdCritical(double value);
    bool setUpperThresholdCritical(double value);
    bool setLowerThresholdFatal(double value);
    bool setUpperThresholdFatal(double value);

private:
    // Stores the value times the multiplier, truncated toward zero. Returns true.
    bool storeScaled(std::int32_t& field, double value) const;

    // A machine may have thousands of sensors, so a record is small. A string stores a few codes
    // in place, where a vector would allocate; a list that grows by the same elements is stored as
    // the number of repetitions; labels point into the value tables, which are static.
    using Codes = std::u16string;

    std::string deviceID_;
    std::string elementName_;
    Codes possibleStates_; // node statuses
    Codes operationalStatus_;
    const char* currentState_ = "";
    const char* healthStatus_ = "";
    double readingMultiplier_ = 1.0;
    std::uint16_t baseUnits_ = 0;
    std::uint16_t rateUnits_ = 0;
    std::uint32_t fixedStateLabels_ = 0;    // how many times they are appended
    std::uint32_t supportedThresholds_ = 0; // how many times 0 to 5 is appended
    std::uint32_t settableThresholds_ = 0;  // how many times 0 to 5 is appended
    std::uint16_t sensorType_ = 0;
    std::uint16_t enabledState_ = 0;
    std::uint16_t requestedState_ = 0;
    std::uint16_t healthState_ = 0;
    std::int32_t currentReading_ = 0;
    std::int32_t unitModifier_ = 0;
    std::int32_t lowerThresholdNonCritical_ = 0;
    std::int32_t upperThresholdNonCritical_ = 0;
    std::int32_t lowerThresholdCritical_ = 0;
    std::int32_t upperThresholdCritical_ = 0;
    std::int32_t lowerThresholdFatal_ = 0;
    std::int32_t upperThresholdFatal_ = 0;
};

// The constructor is defined outside of the class: otherwise a vector would fill a new record with
// zeros before it calls the constructor.
inline Sensor::Sensor() = default;

} // namespace Vorn::SensorProfileProvider
