// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Builds an instance of ZUMLO_NumericSensor from a record.

#include "factory/BrokerCalls.h"
#include "factory/ClassNames.h"
#include "factory/InstanceWriter.h"
#include "factory/PropertySelection.h"
#include "factory/RequestTexts.h"
#include "factory/SensorFactory.h"
#include "factory/TraceLines.h"

#include <cmpimacs.h>

#include <array>
#include <optional>

namespace Vorn::SensorProfileProvider {

namespace {

constexpr const char* operation = "makeSensorInstance";

// Makes an instance with its property filter and keys. Returns what the broker returned when that
// is not usable.
CMPIInstance* newSensorInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
    const Sensor& sensor, const std::string& systemName, const char** properties)
{
    const CMPIObjectPath* const path = newPath(broker, ref, SensorClass, systemName, nullptr);
    if (path == nullptr)
        return nullptr;
    CMPIInstance* const instance = CMNewInstance(broker, path, nullptr);
    if (!isUsable(instance))
        return instance;
    std::array<const char*, 5> keys = {
        "CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName", nullptr};
    CMSetPropertyFilter(instance, properties, keys.data());
    const InstanceWriter writer(broker, instance);
    writer.setText("CreationClassName", SensorClass);
    writer.setText("DeviceID", sensor.getDeviceID());
    writer.setText("SystemCreationClassName", ComputerSystemClass);
    writer.setText("SystemName", systemName);
    return instance;
}

// The report of an array that the broker cannot create.
struct ArrayFailure {
    const char* statusText;
    const char* traceText;
    std::optional<unsigned> exitingLine; // absent where no exit line is written
};

// The runs of blanks are part of the texts.
constexpr const char* supportedThresholdsFailed =
    "Create Array for Property                         SupportedThresholds failed.";
constexpr const char* settableThresholdsFailed =
    "Create Array for Property                         SettableThresholds failed.";
constexpr const char* operationalStatusFailed =
    "Create Array for Property                         OperationalStatus failed.";
constexpr const char* operationalStatusFailedTrace =
    "Create Array for Property Operat                        ionalStatus failed.";

// Sets the selected properties of one instance in order.
class SensorProperties {
public:
    SensorProperties(Sensor& sensor, const RequestTexts& texts, PropertySelection& selection,
        const InstanceWriter& writer, CMPIStatus* rc)
        : sensor_(sensor), texts_(texts), selection_(selection), writer_(writer), rc_(rc)
    {
    }

    // Returns the failure that ended the build, if there was one.
    std::optional<ArrayFailure> set()
    {
        setNames();
        setPossibleStates();
        setCode("BaseUnits", sensor_.getBaseUnits());
        setCode("RateUnits", sensor_.getRateUnits());
        if (!setCodes("SupportedThresholds", sensor_.getSupportedThresholds()))
            return ArrayFailure{supportedThresholdsFailed, supportedThresholdsFailed, {}};
        if (!setCodes("SettableThresholds", sensor_.getSettableThresholds()))
            return ArrayFailure{settableThresholdsFailed, settableThresholdsFailed, {}};
        setStates();
        if (!setCodes("OperationalStatus", sensor_.getOperationalStatus()))
            return ArrayFailure{operationalStatusFailed, operationalStatusFailedTrace,
                FactoryLines::operationalStatusFailed};
        setMeasurements();
        return std::nullopt;
    }

private:
    void setNames() const
    {
        const std::string name = sensor_.getElementName();
        if (selection_.selects("Caption"))
            writer_.setText("Caption", texts_.caption(name));
        if (selection_.selects("Description"))
            writer_.setText("Description", texts_.description(name));
        setText("Name", name);
        setText("ElementName", name);
        setText("CurrentState", sensor_.getCurrentState());
    }

    void setPossibleStates() const
    {
        if (!selection_.selects("PossibleStates"))
            return;
        const std::vector<std::string> states = sensor_.getPossibleStates();
        if (static_cast<std::uint16_t>(states.size()) == 0)
            return; // unlike an empty list of codes, it is not set
        if (!writer_.setTexts("PossibleStates", states, rc_))
            traceMessage(factoryModule(), operation, FactoryLines::possibleStatesFailed,
                "Failed to create CMPIArray for PossibleStates");
    }

    void setStates() const
    {
        setCode("SensorType", sensor_.getSensorType());
        setCode("EnabledState", sensor_.getEnabledState());
        setCode("RequestedState", sensor_.getRequestedState());
        if (selection_.selects("HealthState")) {
            writer_.setCode("HealthState", sensor_.getHealthState());
            writer_.setText("Status", sensor_.getHealthStatus()); // never without HealthState
        }
    }

    void setMeasurements() const
    {
        setNumber("CurrentReading", sensor_.getCurrentReading());
        setNumber("UnitModifier", sensor_.getUnitModifier());
        setThreshold("LowerThresholdNonCritical", sensor_.getLowerThresholdNonCritical());
        setThreshold("UpperThresholdNonCritical", sensor_.getUpperThresholdNonCritical());
        setThreshold("LowerThresholdCritical", sensor_.getLowerThresholdCritical());
        setThreshold("UpperThresholdCritical", sensor_.getUpperThresholdCritical());
        setThreshold("LowerThresholdFatal", sensor_.getLowerThresholdFatal());
        setThreshold("UpperThresholdFatal", sensor_.getUpperThresholdFatal());
    }

    void setText(const char* name, const std::string& text) const
    {
        if (selection_.selects(name))
            writer_.setText(name, text);
    }

    void setCode(const char* name, std::uint16_t code) const
    {
        if (selection_.selects(name))
            writer_.setCode(name, code);
    }

    void setNumber(const char* name, std::int32_t number) const
    {
        if (selection_.selects(name))
            writer_.setNumber(name, number);
    }

    // 0 means that the sensor has no such threshold.
    void setThreshold(const char* name, std::int32_t threshold) const
    {
        if (threshold != 0)
            setNumber(name, threshold);
    }

    bool setCodes(const char* name, const std::vector<std::uint16_t>& codes) const
    {
        return !selection_.selects(name) || writer_.setCodes(name, codes, rc_);
    }

    Sensor& sensor_;
    const RequestTexts& texts_;
    PropertySelection& selection_;
    const InstanceWriter& writer_;
    CMPIStatus* rc_;
};

} // namespace

CMPIInstance* SensorFactory::makeSensorInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
    Sensor snsr, const char** properties, bool isObjPath, CMPIStatus* rc)
{
    PropertySelection selection(properties, isObjPath);
    return makeInstance(broker, ref, snsr, properties, selection, isObjPath, rc);
}

CMPIInstance* SensorFactory::makeInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
    Sensor& snsr, const char** properties, PropertySelection& selection, bool isObjPath,
    CMPIStatus* rc)
{
    const TracedOperation traced(factoryModule(), operation, [&] {
        return parameterList(" broker=", broker, " ref=", ref, " snsr=", &snsr,
            " properties=", properties, " isObjPath=", isObjPath, " rc=", rc);
    });
    traced.entering(FactoryLines::makeSensorInstance.entry);
    CMPIInstance* const instance =
        newSensorInstance(broker, ref, snsr, texts.systemName(), properties);
    if (isUsable(instance)) {
        const InstanceWriter writer(broker, instance);
        const auto failure = SensorProperties(snsr, texts, selection, writer, rc).set();
        if (failure) {
            reportFailure(
                broker, rc, SensorProfileProvider, failure->statusText, failure->traceText);
            if (failure->exitingLine)
                traced.exiting(*failure->exitingLine);
            return instance;
        }
    }
    traced.exiting(FactoryLines::makeSensorInstance.exit);
    return instance;
}

} // namespace Vorn::SensorProfileProvider
