// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "companion/BrokerObjects.h"

#include "platform/utilities/ProviderUtilities.h"

#include <cmpimacs.h>

namespace Vorn::Companion {

namespace {

// Returns the path as a value, which has no place for one that is const; the broker copies the
// path.
CMPIValue referenceTo(const CMPIObjectPath* path)
{
    return {.ref = const_cast<CMPIObjectPath*>(path)};
}

// The value is a whole CMPIValue, or characters: an object manager may copy one from the address
// whatever the type.

bool storeKey(const CMPIObjectPath* path, const char* name, const void* value, CMPIType type)
{
    return isUsable(path) && CMAddKey(path, name, value, type).rc == CMPI_RC_OK;
}

bool storeProperty(const CMPIInstance* instance, const char* name, const void* value, CMPIType type)
{
    return isUsable(instance) && CMSetProperty(instance, name, value, type).rc == CMPI_RC_OK;
}

void setList(const CMPIBroker* broker, const CMPIInstance* instance, const char* name,
    const CMPIValue& element, CMPIType type)
{
    CMPIArray* const array = CMNewArray(broker, 1, type, nullptr);
    if (!isUsable(array))
        return;
    const CMPIStatus set = CMSetArrayElementAt(array, 0, &element, type);
    const CMPIValue value = {.array = array};
    if (set.rc == CMPI_RC_OK && isUsable(array))
        storeProperty(instance, name, &value, static_cast<CMPIType>(type | CMPI_ARRAY));
}

} // namespace

bool isOfClass(const CMPIObjectPath* path, const char* className)
{
    const char* const actual =
        isUsable(path) ? charactersOf(CMGetClassName(path, nullptr)) : nullptr;
    return actual != nullptr && isSameName(actual, className);
}

CMPIObjectPath* newPathIn(
    const CMPIBroker* broker, const char* nameSpace, const char* className, const std::string& host)
{
    if (nameSpace == nullptr)
        return nullptr;
    CMPIObjectPath* const path = CMNewObjectPath(broker, nameSpace, className, nullptr);
    if (isUsable(path))
        CMSetHostname(path, host.c_str());
    return isUsable(path) ? path : nullptr;
}

bool addKey(const CMPIObjectPath* path, const char* name, const char* text)
{
    return storeKey(path, name, text, CMPI_chars);
}

bool addKey(const CMPIObjectPath* path, const char* name, const CMPIObjectPath* reference)
{
    const CMPIValue value = referenceTo(reference);
    return isUsable(reference) && storeKey(path, name, &value, CMPI_ref);
}

bool setText(const CMPIInstance* instance, const char* name, const char* text)
{
    return storeProperty(instance, name, text, CMPI_chars);
}

bool setReference(const CMPIInstance* instance, const char* name, const CMPIObjectPath* reference)
{
    const CMPIValue value = referenceTo(reference);
    return isUsable(reference) && storeProperty(instance, name, &value, CMPI_ref);
}

void setCode(const CMPIInstance* instance, const char* name, std::uint16_t code)
{
    const CMPIValue value = {.uint16 = code};
    storeProperty(instance, name, &value, CMPI_uint16);
}

void setCodes(
    const CMPIBroker* broker, const CMPIInstance* instance, const char* name, std::uint16_t code)
{
    setList(broker, instance, name, {.uint16 = code}, CMPI_uint16);
}

void setTexts(
    const CMPIBroker* broker, const CMPIInstance* instance, const char* name, const char* text)
{
    CMPIString* const string = CMNewString(broker, text, nullptr);
    if (isUsable(string))
        setList(broker, instance, name, {.string = string}, CMPI_string);
}

} // namespace Vorn::Companion
