// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/broker/Broker.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "host/broker/Result.h"

#include <gtest/gtest.h>

#include <vector>

namespace Testing {

// One EnumInstances request for the sensors, whose instances live as long as the object.
class SensorRequest {
public:
    SensorRequest(Host::Broker& broker, CMPIInstanceMI* mi) : request_(broker)
    {
        Host::Result result(answer_);
        const CMPIStatus status =
            mi->ft->enumerateInstances(mi, request_.context().handle(), result.handle(),
                request_.makePath("root/cimv2", "ZUMLO_NumericSensor").handle(), nullptr);
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_TRUE(answer_.isDone());
    }

    const std::vector<const Host::Instance*>& instances() const { return answer_.instances(); }

private:
    Host::Request request_;
    Host::CollectedResult answer_;
};

} // namespace Testing
