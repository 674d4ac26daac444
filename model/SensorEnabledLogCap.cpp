// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "model/SensorEnabledLogCap.h"

namespace Vorn::SensorProfileProvider {

std::string SensorEnabledLogCap::getInstanceID()
{
    instanceID_ = "ZUMLO:SensorEnabledLogicalElementCap1";
    return instanceID_;
}

bool SensorEnabledLogCap::getElementNameEditSupported()
{
    elementNameEditSupported_ = false;
    return elementNameEditSupported_;
}

std::vector<std::uint16_t> SensorEnabledLogCap::getStatesSupported()
{
    statesSupported_.insert(statesSupported_.end(), {0, 1, 2});
    return statesSupported_;
}

} // namespace Vorn::SensorProfileProvider
