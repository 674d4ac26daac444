// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance provider of a class with one instance.

#pragma once

#include "companion/ResultWriter.h"
#include "platform/utilities/ProviderUtilities.h"

#include <atomic>

namespace Vorn::Companion {

// `Object` is constructed for each request. `path(broker, nameSpace)` returns the instance's path,
// and `instance(broker, path, properties)` the instance; each returns null when the broker fails.
// `provider` is the name of the table, `notFound` the message for other keys.
template <typename Object>
class SingleInstanceProvider {
public:
    // Returns the provider's only record, now with this broker; null when there is no broker.
    static CMPIInstanceMI* create(const CMPIBroker* broker, CMPIStatus* status)
    {
        static constexpr CMPIInstanceMIFT table =
            instanceTable(Object::provider, {enumerateNames, enumerate, get});
        static CMPIInstanceMI mi = {nullptr, &table};
        return createdWith(broker, status, theBroker, mi);
    }

private:
    // Returns what `work(broker, object, path)` makes to the object manager.
    template <typename Work>
    static CMPIStatus serve(const CMPIResult* result, const CMPIObjectPath* ref, const Work& work)
    {
        const CMPIBroker* const broker = theBroker;
        return guarded(broker, [&] {
            const Object object;
            const CMPIObjectPath* const path = object.path(broker, nameSpaceOf(ref));
            ResultWriter writer(broker, result);
            if (path == nullptr)
                writer.add(path);
            else
                writer.add(work(broker, object, path));
            return writer.finish();
        });
    }

    static CMPIStatus enumerateNames(
        CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* ref)
    {
        return serve(result, ref,
            [](const CMPIBroker*, const Object&, const CMPIObjectPath* path) { return path; });
    }

    static CMPIStatus enumerate(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
        const CMPIObjectPath* ref, const char** properties)
    {
        return serve(result, ref,
            [&](const CMPIBroker* broker, const Object& object, const CMPIObjectPath* path) {
                return object.instance(broker, path, properties);
            });
    }

    static CMPIStatus get(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
        const CMPIObjectPath* ref, const char** properties)
    {
        return serve(result, ref,
            [&](const CMPIBroker* broker, const Object& object, const CMPIObjectPath* path) {
                if (!isObjPathsEqual(path, ref, false))
                    throw RequestFailure(CMPI_RC_ERR_NOT_FOUND, Object::notFound);
                return object.instance(broker, path, properties);
            });
    }

    // Some object managers call the factory again while requests run.
    static inline std::atomic<const CMPIBroker*> theBroker = nullptr;
};

} // namespace Vorn::Companion
