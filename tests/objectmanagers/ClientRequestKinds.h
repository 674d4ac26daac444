// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Classifies requests into the kinds by which the answers of object managers differ.

#pragma once

#include "tests/objectmanagers/ClientRequest.h"

#include <strings.h>

#include <initializer_list>
#include <string>

namespace Testing {

inline constexpr const char* systemDevice = "ZUMLO_SensorSystemDevice";
inline constexpr const char* elementCapabilities = "ZUMLO_SensorElementCapabilities";
inline constexpr const char* conformance = "ZUMLO_SensorElementConformsToProfile";

inline bool isSame(const std::string& one, const std::string& other)
{
    return strcasecmp(one.c_str(), other.c_str()) == 0;
}

inline bool isOneOf(const std::string& name, std::initializer_list<const char*> names)
{
    for (const char* each : names)
        if (isSame(name, each))
            return true;
    return false;
}

inline bool isSystemDevice(const ClientRequest& request)
{
    return isOneOf(request.association, {systemDevice, "CIM_SystemDevice", "CIM_Component"});
}

inline bool isElementCapabilities(const ClientRequest& request)
{
    return isOneOf(request.association, {elementCapabilities, "CIM_ElementCapabilities"});
}

inline bool isConformance(const ClientRequest& request)
{
    return isOneOf(request.association, {conformance, "CIM_ElementConformsToProfile"});
}

inline bool isFrom(const ClientRequest& request, const char* className)
{
    return request.object.starts_with(className + std::string("."));
}

inline bool isFromSystem(const ClientRequest& request)
{
    return isFrom(request, "ZUMLO_ComputerSystem");
}

inline bool isFromCapabilities(const ClientRequest& request)
{
    return isFrom(request, "ZUMLO_SensorEnabledLogicalElementCapabilities");
}

inline bool isFromSensor(const ClientRequest& request)
{
    return isFrom(request, "ZUMLO_NumericSensor");
}

inline bool isOnAssociations(const ClientRequest& request)
{
    return request.isAssociators() || request.isReferences();
}

} // namespace Testing
