// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "providers/AssociationRequests.h"

#include <cmpidt.h>

#include <vector>

namespace Vorn::SensorProfileProvider {

// Base of the iterations over all pairs of an association: holds the factory, enumerates the ends
// and makes the path of each pair.
class AssociationWalk {
public:
    AssociationWalk(const AssociationRequest& request, const CMPIObjectPath* op, CMPIStatus* status)
        : request_(request), op_(op), status_(status), factory_(true, request.served().isCap)
    {
    }

    // Reserves capacity for one object per sensor.
    template <typename Object>
    void reserve(std::vector<Object*>& objects)
    {
        objects.reserve(factory_.getNumberOfInstances());
    }

    // Returns whether the last enumeration of sensors found none, as opposed to a failure of the
    // broker.
    bool foundNoSensors() const { return sensorsResult_ == nothingFound; }

protected:
    const AssociationRequest& request() const { return request_; }
    const CMPIObjectPath* op() const { return op_; }
    CMPIStatus* status() const { return status_; }

    // Append paths. Return false when there are none or the broker failed.
    bool fetchSensors(std::vector<CMPIObjectPath*>& paths)
    {
        reserve(paths);
        sensorsResult_ = factory_.getAllSensorCMPIObjPaths(request_.broker(), op_, paths, status_);
        return sensorsResult_ == 0;
    }
    bool fetchCapabilities(std::vector<CMPIObjectPath*>& paths)
    {
        return factory_.getAllSensorEnabledLogicalElementCapCMPIObjPaths(
                   request_.broker(), op_, paths, status_) == 0;
    }

    // Calls `visit` with a new path of the association, without keys, and its references. Returns
    // false after it reported that the path cannot be made.
    template <typename Visit>
    bool visitPair(const CMPIObjectPath* sensor, const CMPIObjectPath* other,
        const FailureTexts& withoutPath, const Visit& visit)
    {
        const CMPIObjectPath* const path =
            newPath(request_.broker(), op_, request_.served().name, factory_.systemName(), status_);
        if (path == nullptr) {
            request_.fail(withoutPath, status_);
            return false;
        }
        visit(path, request_.served().pair(sensor, other));
        return true;
    }

private:
    static constexpr int nothingFound = 1; // of the factory's results

    const AssociationRequest& request_;
    const CMPIObjectPath* op_;
    CMPIStatus* status_;
    SensorFactory factory_;
    int sensorsResult_ = 0;
};

} // namespace Vorn::SensorProfileProvider
