// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "providers/RequestHandler.h"

#include "factory/BrokerCalls.h"
#include "platform/utilities/ProviderUtilities.h"

#include <cmpimacs.h>

#include <algorithm>

namespace Vorn::SensorProfileProvider {

CMPICount keyCountOf(const CMPIObjectPath* ref, CMPIStatus* status)
{
    return isUsable(ref) ? CMGetKeyCount(ref, status) : 0;
}

CMPIString* textKey(const CMPIObjectPath* ref, const char* name, CMPIStatus* status)
{
    const CMPIData key = CMGetKey(ref, name, status);
    constexpr CMPIValueState absent = CMPI_nullValue | CMPI_notFound | CMPI_badValue;
    if (key.type == CMPI_string && (key.state & absent) == 0 && isUsable(key.value.string))
        return key.value.string;
    *status = {CMPI_RC_OK, nullptr};
    return nullptr;
}

void returnInstances(const CMPIResult* rslt, const std::vector<CMPIInstance*>& instances)
{
    forEachCounted(
        instances, [&](const CMPIInstance* instance) { CMReturnInstance(rslt, instance); });
}

void returnPaths(const CMPIResult* rslt, const CMPIObjectPath* ref,
    const std::vector<CMPIObjectPath*>& paths, CMPIStatus* status)
{
    for (const CMPIObjectPath* const path : paths) {
        if (!isUsable(path))
            continue;
        copyNameSpace(path, ref, status);
        CMReturnObjectPath(rslt, path);
    }
}

void returnInstanceAt(const CMPIResult* rslt, const CMPIObjectPath* ref,
    const std::vector<CMPIInstance*>& instances, bool comparesReferences, CMPIStatus* status)
{
    const auto end = instances.begin() + static_cast<std::uint16_t>(instances.size());
    const auto found = std::find_if(instances.begin(), end, [&](const CMPIInstance* instance) {
        return isUsable(instance) &&
               isObjPathsEqual(CMGetObjectPath(instance, status), ref, comparesReferences);
    });
    if (found != end)
        CMReturnInstance(rslt, *found);
}

} // namespace Vorn::SensorProfileProvider
