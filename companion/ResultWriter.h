// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Returns objects to the object manager.

#pragma once

#include "companion/ProviderTables.h"

namespace Vorn::Companion {

// Writes objects to the result of a request. After a failure it writes nothing more, and the
// request ends with the status of that failure.
class ResultWriter {
public:
    ResultWriter(const CMPIBroker* broker, const CMPIResult* result)
        : broker_(broker), result_(result)
    {
    }

    // Write the object; null stands for one that the broker failed to make.
    void add(const CMPIObjectPath* path)
    {
        if (isWanted(path, "the object path cannot be made"))
            status_ = CMReturnObjectPath(result_, path);
    }
    void add(const CMPIInstance* instance)
    {
        if (isWanted(instance, "the instance cannot be made"))
            status_ = CMReturnInstance(result_, instance);
    }

    // Completes the result unless something failed. Returns the status of the request.
    CMPIStatus finish() const { return status_.rc == CMPI_RC_OK ? CMReturnDone(result_) : status_; }

private:
    template <typename Object>
    bool isWanted(const Object* object, const char* whatFails)
    {
        if (status_.rc == CMPI_RC_OK && !isUsable(object))
            status_ = failure(broker_, CMPI_RC_ERR_FAILED, whatFails);
        return status_.rc == CMPI_RC_OK;
    }

    const CMPIBroker* broker_;
    const CMPIResult* result_;
    CMPIStatus status_ = okStatus;
};

} // namespace Vorn::Companion
