// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An object manager with two sensors in one namespace and the registration of their profile in
// another, which answers the up-calls of the association with them.

#pragma once

#include "host/broker/BrokerUpcalls.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"

#include <string>
#include <vector>

namespace Testing {

class ScriptedObjects : public Host::BrokerUpcalls {
public:
    static constexpr const char* SensorClass = "ZUMLO_NumericSensor";
    static constexpr const char* ProfileClass = "ZUMLO_SensorRegisteredProfile";

    std::string interop = "root/interop";
    std::string sensorNameSpace = "root/cimv2";
    std::vector<std::string> sensors = {"CPU", "Fan"};
    bool givesNameSpaces = true; // to the paths that it returns
    CMPIrc missing = CMPI_RC_ERR_INVALID_CLASS;
    CMPIrc sensorFailure = CMPI_RC_OK;
    std::vector<std::string> calls; // as NAMESPACE:CLASS

    Host::Enumeration& enumerateInstanceNames(
        const Host::Context&, const Host::ObjectPath& path) override
    {
        std::vector<Host::Value> answer = {
            Host::Value::text(Host::Arena::required(), "a text"), Host::Value::null(CMPI_ref)};
        for (const Host::ObjectPath* const each : pathsOf(path))
            answer.push_back(Host::Value::of(*each));
        return Host::Enumeration::make(Host::Arena::required(), answer);
    }

    Host::Enumeration& enumerateInstances(
        const Host::Context&, const Host::ObjectPath& path, const char** properties) override
    {
        Host::Arena& arena = Host::Arena::required();
        std::vector<Host::Value> answer = {Host::Value::null(CMPI_instance)};
        for (const Host::ObjectPath* const each : pathsOf(path)) {
            Host::Instance& instance = Host::Instance::make(arena, *each, nullptr);
            instance.setProperty("DeviceID", *each->key("DeviceID"));
            if (properties == nullptr)
                instance.setProperty("Caption", Host::Value::text(arena, "A sensor"));
            answer.push_back(Host::Value::of(instance));
        }
        return Host::Enumeration::make(arena, answer);
    }

private:
    std::vector<const Host::ObjectPath*> pathsOf(const Host::ObjectPath& path)
    {
        const std::string place = std::string(path.nameSpace()) + ":";
        calls.push_back(place + std::string(path.className()));
        if (calls.back() == interop + ":" + ProfileClass)
            return {&make(path, "InstanceID", "ZUMLO:DSP1009")};
        if (calls.back() == interop + ":CIM_Namespace")
            return {&make(path, "Name", interop), &make(path, "Name", sensorNameSpace)};
        if (calls.back() != sensorNameSpace + ":" + SensorClass)
            throw Host::Refusal(missing, "nobody serves it");
        if (sensorFailure != CMPI_RC_OK)
            throw Host::Refusal(sensorFailure, "no sensors today");
        std::vector<const Host::ObjectPath*> paths;
        for (const std::string& sensor : sensors)
            paths.push_back(&make(path, "DeviceID", sensor));
        return paths;
    }

    Host::ObjectPath& make(
        const Host::ObjectPath& of, const char* key, const std::string& value) const
    {
        Host::Arena& arena = Host::Arena::required();
        Host::ObjectPath& path = Host::ObjectPath::make(
            arena, givesNameSpaces ? of.nameSpace() : std::string_view(), of.className());
        path.addKey(key, Host::Value::text(arena, value));
        return path;
    }
};

} // namespace Testing
