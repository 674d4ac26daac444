// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "companion/ProviderUpcalls.h"

#include "companion/ProviderTables.h"
#include "platform/utilities/ProviderUtilities.h"

namespace Vorn::Companion {

namespace {

// Returns whether the status means that the namespace has no such class or no provider of it.
bool isWithoutProvider(const CMPIStatus& status)
{
    return status.rc == CMPI_RC_ERR_INVALID_NAMESPACE || status.rc == CMPI_RC_ERR_INVALID_CLASS ||
           status.rc == CMPI_RC_ERR_NOT_FOUND || status.rc == CMPI_RC_ERR_NOT_SUPPORTED;
}

[[noreturn]] void fail(const char* className, const CMPIStatus& status)
{
    std::string message = "the instances of " + std::string(className) + " cannot be enumerated";
    if (const char* const reason = charactersOf(status.msg))
        message.append(": ").append(reason);
    throw RequestFailure(status.rc, message);
}

// Object managers differ in whether a path that is returned to a provider has its namespace.
CMPIObjectPath* inNameSpace(CMPIObjectPath* path, const std::string& nameSpace)
{
    const char* const actual = nameSpaceOf(path);
    if (actual == nullptr || !isSameName(actual, nameSpace))
        CMSetNameSpace(path, nameSpace.c_str());
    return path;
}

} // namespace

template <typename Enumerate>
std::vector<CMPIValue> ProviderUpcalls::elements(const std::string& nameSpace,
    const char* className, CMPIType type, const Enumerate& enumerate) const
{
    const CMPIObjectPath* const path =
        newPathIn(broker_, nameSpace.c_str(), className, getSystemName());
    if (path == nullptr)
        fail(className, {CMPI_RC_ERR_FAILED, nullptr});
    std::vector<CMPIValue> found;
    CMPIStatus status = okStatus;
    const CMPIEnumeration* const all = enumerate(path, &status);
    while (status.rc == CMPI_RC_OK && isUsable(all) && CMHasNext(all, &status)) {
        // The state of an element is ignored, since object managers differ in it.
        const CMPIData element = CMGetNext(all, &status);
        if (status.rc == CMPI_RC_OK && element.type == type)
            found.push_back(element.value);
    }
    if (isWithoutProvider(status))
        return {};
    if (status.rc != CMPI_RC_OK)
        fail(className, status);
    return found;
}

std::vector<CMPIObjectPath*> ProviderUpcalls::names(
    const std::string& nameSpace, const char* className) const
{
    const auto enumerate = [this](const CMPIObjectPath* path, CMPIStatus* status) {
        return CBEnumInstanceNames(broker_, context_, path, status);
    };
    std::vector<CMPIObjectPath*> paths;
    for (const CMPIValue& element : elements(nameSpace, className, CMPI_ref, enumerate))
        if (isUsable(element.ref))
            paths.push_back(inNameSpace(element.ref, nameSpace));
    return paths;
}

std::vector<CMPIInstance*> ProviderUpcalls::instances(
    const std::string& nameSpace, const char* className, const char** properties) const
{
    const auto enumerate = [&](const CMPIObjectPath* path, CMPIStatus* status) {
        return CBEnumInstances(broker_, context_, path, properties, status);
    };
    std::vector<CMPIInstance*> all;
    for (const CMPIValue& element : elements(nameSpace, className, CMPI_instance, enumerate))
        if (isUsable(element.inst))
            all.push_back(element.inst);
    return all;
}

} // namespace Vorn::Companion
