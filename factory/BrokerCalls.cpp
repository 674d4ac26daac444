// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "factory/BrokerCalls.h"

#include <cmpimacs.h>

#include <cstring>

namespace Vorn::SensorProfileProvider {

CMPIString* classNameOf(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return isUsable(path) ? CMGetClassName(path, rc) : nullptr;
}

CMPIObjectPath* newPath(const CMPIBroker* broker, const CMPIObjectPath* ref, const char* className,
    const std::string& host, CMPIStatus* rc, CMPIStatus* again)
{
    const char* const nameSpace = nameSpaceOf(ref, rc);
    if (nameSpace == nullptr || broker == nullptr)
        return nullptr;
    CMPIObjectPath* const path = CMNewObjectPath(broker, nameSpace, className, rc);
    if (!isUsable(path))
        return nullptr;
    copyNameSpace(path, ref, again);
    CMSetHostname(path, host.c_str());
    return path;
}

void copyNameSpace(const CMPIObjectPath* path, const CMPIObjectPath* ref, CMPIStatus* rc)
{
    if (const char* const nameSpace = nameSpaceOf(ref, rc))
        CMSetNameSpace(path, nameSpace);
}

bool isExactlyOfClass(const CMPIObjectPath* path, const char* className)
{
    const char* const characters = charactersOf(classNameOf(path, nullptr));
    return characters != nullptr && std::strcmp(characters, className) == 0;
}

void addTextKey(const CMPIObjectPath* path, const char* name, const char* text)
{
    CMAddKey(path, name, text, CMPI_chars);
}

void traceToBroker(
    const CMPIBroker* broker, CMPILevel level, const char* component, const char* text)
{
    if (broker != nullptr)
        CMTraceMessage(broker, level, component, text, nullptr);
}

void reportFailure(const CMPIBroker* broker, CMPIStatus* rc, const char* component,
    const char* statusText, const char* traceText)
{
    if (rc != nullptr) {
        rc->rc = CMPI_RC_ERR_FAILED;
        rc->msg = broker != nullptr ? CMNewString(broker, statusText, nullptr) : nullptr;
    }
    traceToBroker(broker, CMPI_LEV_WARNING, component, traceText);
}

} // namespace Vorn::SensorProfileProvider
