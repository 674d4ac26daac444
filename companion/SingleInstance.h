// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance provider of a class with one instance.

#pragma once

#include "companion/ProviderTables.h"
#include "platform/utilities/ProviderUtilities.h"

#include <atomic>

namespace Vorn::Companion {

// `Object` is constructed for each request. `path(broker, ref)` returns the instance's path in the
// namespace of `ref`, and `instance(broker, path, properties)` the instance; each returns null when
// the broker fails. `provider` is the name of the table, `notFound` the message for other keys.
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
    // Calls `work` with the object and its path.
    template <typename Work>
    static CMPIStatus serve(const CMPIObjectPath* ref, const Work& work)
    {
        const CMPIBroker* const broker = theBroker;
        return guarded(broker, [&] {
            const Object object;
            const CMPIObjectPath* const path = object.path(broker, ref);
            if (path == nullptr)
                return failure(broker, CMPI_RC_ERR_FAILED, "the object path cannot be made");
            return work(broker, object, path);
        });
    }

    // Completes the result unless a delivery to it failed.
    static CMPIStatus closed(const CMPIResult* result, const CMPIStatus& delivery)
    {
        return delivery.rc == CMPI_RC_OK ? CMReturnDone(result) : delivery;
    }

    static CMPIStatus returnInstance(const CMPIBroker* broker, const CMPIResult* result,
        const Object& object, const CMPIObjectPath* path, const char** properties)
    {
        const CMPIInstance* const instance = object.instance(broker, path, properties);
        if (instance == nullptr)
            return failure(broker, CMPI_RC_ERR_FAILED, "the instance cannot be made");
        return closed(result, CMReturnInstance(result, instance));
    }

    static CMPIStatus enumerateNames(
        CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* ref)
    {
        return serve(ref, [&](const CMPIBroker*, const Object&, const CMPIObjectPath* path) {
            return closed(result, CMReturnObjectPath(result, path));
        });
    }

    static CMPIStatus enumerate(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
        const CMPIObjectPath* ref, const char** properties)
    {
        return serve(
            ref, [&](const CMPIBroker* broker, const Object& object, const CMPIObjectPath* path) {
                return returnInstance(broker, result, object, path, properties);
            });
    }

    static CMPIStatus get(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
        const CMPIObjectPath* ref, const char** properties)
    {
        return serve(
            ref, [&](const CMPIBroker* broker, const Object& object, const CMPIObjectPath* path) {
                if (!isObjPathsEqual(path, ref, false))
                    return failure(broker, CMPI_RC_ERR_NOT_FOUND, Object::notFound);
                return returnInstance(broker, result, object, path, properties);
            });
    }

    // Some object managers call the factory again while requests run.
    static inline std::atomic<const CMPIBroker*> theBroker = nullptr;
};

} // namespace Vorn::Companion
