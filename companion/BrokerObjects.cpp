// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "companion/BrokerObjects.h"

#include "platform/utilities/ProviderUtilities.h"

#include <cmpimacs.h>

namespace Vorn::Companion {

namespace {

// An object manager may copy a whole CMPIValue from the address it is passed, whatever the type:
// all but texts are such values.

// The value has no place for a path that is const; the broker copies the path.
CMPIValue referenceTo(const CMPIObjectPath* path)
{
    return {.ref = const_cast<CMPIObjectPath*>(path)};
}

const char* charactersOf(const CMPIString* string)
{
    // The slot itself: header sets differ in the convenience function's arguments.
    return isUsable(string) ? string->ft->getCharPtr(string, nullptr) : nullptr;
}

void setList(const CMPIBroker* broker, const CMPIInstance* instance, const char* name,
    const CMPIValue& element, CMPIType type)
{
    CMPIArray* const array = CMNewArray(broker, 1, type, nullptr);
    if (!isUsable(array))
        return;
    const CMPIStatus set = CMSetArrayElementAt(array, 0, &element, type);
    const CMPIValue value = {.array = array};
    if (set.rc == CMPI_RC_OK && isUsable(array) && isUsable(instance))
        CMSetProperty(instance, name, &value, static_cast<CMPIType>(type | CMPI_ARRAY));
}

} // namespace

const char* nameSpaceOf(const CMPIObjectPath* path)
{
    return isUsable(path) ? charactersOf(CMGetNameSpace(path, nullptr)) : nullptr;
}

bool isOfClass(const CMPIObjectPath* path, const char* className)
{
    const char* const actual =
        isUsable(path) ? charactersOf(CMGetClassName(path, nullptr)) : nullptr;
    return actual != nullptr && isSameName(actual, className);
}

CMPIObjectPath* newPath(
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
    return isUsable(path) && CMAddKey(path, name, text, CMPI_chars).rc == CMPI_RC_OK;
}

bool addKey(const CMPIObjectPath* path, const char* name, const CMPIObjectPath* reference)
{
    const CMPIValue value = referenceTo(reference);
    return isUsable(path) && isUsable(reference) &&
           CMAddKey(path, name, &value, CMPI_ref).rc == CMPI_RC_OK;
}

bool setText(const CMPIInstance* instance, const char* name, const char* text)
{
    return isUsable(instance) && CMSetProperty(instance, name, text, CMPI_chars).rc == CMPI_RC_OK;
}

bool setReference(const CMPIInstance* instance, const char* name, const CMPIObjectPath* reference)
{
    const CMPIValue value = referenceTo(reference);
    return isUsable(instance) && isUsable(reference) &&
           CMSetProperty(instance, name, &value, CMPI_ref).rc == CMPI_RC_OK;
}

void setCode(const CMPIInstance* instance, const char* name, std::uint16_t code)
{
    const CMPIValue value = {.uint16 = code};
    if (isUsable(instance))
        CMSetProperty(instance, name, &value, CMPI_uint16);
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
