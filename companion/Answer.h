// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Objects returned to the object manager.

#pragma once

#include "companion/ProviderTables.h"

namespace Vorn::Companion {

// Returns all objects or an error: after a failure nothing more is returned.
class Answer {
public:
    Answer(const CMPIBroker* broker, const CMPIResult* result) : broker_(broker), result_(result) {}

    // Return the object; null stands for one that the broker failed to make.
    void add(const CMPIObjectPath* path)
    {
        if (isWanted(path))
            status_ = CMReturnObjectPath(result_, path);
    }
    void add(const CMPIInstance* instance)
    {
        if (isWanted(instance))
            status_ = CMReturnInstance(result_, instance);
    }

    // Completes the result unless something failed. Returns the status of the request.
    CMPIStatus finish() const { return status_.rc == CMPI_RC_OK ? CMReturnDone(result_) : status_; }

private:
    template <typename Object>
    bool isWanted(const Object* object)
    {
        if (status_.rc == CMPI_RC_OK && !isUsable(object))
            status_ = failure(broker_, CMPI_RC_ERR_FAILED, "an object cannot be made");
        return status_.rc == CMPI_RC_OK;
    }

    const CMPIBroker* broker_;
    const CMPIResult* result_;
    CMPIStatus status_ = okStatus;
};

} // namespace Vorn::Companion
