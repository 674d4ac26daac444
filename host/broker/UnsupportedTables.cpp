// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Slot.h"
#include "host/broker/Tables.h"

namespace Host {

const CMPIBrokerExtFT operatingSystemFunctions = {
    .ftVersion = CMPIVersion200,
    .resolveFileName = notOffered,
    .newThread = notOffered,
    .joinThread = notOffered,
    .exitThread = notOffered,
    .cancelThread = notOffered,
    .threadSleep = notOffered,
    .threadOnce = notOffered,
    .createThreadKey = notOffered,
    .destroyThreadKey = notOffered,
    .getThreadSpecific = notOffered,
    .setThreadSpecific = notOffered,
    .newMutex = notOffered,
    .destroyMutex = notOffered,
    .lockMutex = notOffered,
    .unlockMutex = notOffered,
    .newCondition = notOffered,
    .destroyCondition = notOffered,
    .condWait = notOffered,
    .timedCondWait = notOffered,
    .signalCondition = notOffered,
};

const CMPIBrokerMemFT memoryFunctions = {
    .ftVersion = CMPIVersion200,
    .mark = notOffered,
    .release = notOffered,
    .cmpiMalloc = notOffered,
    .cmpiCalloc = notOffered,
    .cmpiRealloc = notOffered,
    .cmpiStrDup = notOffered,
    .cmpiFree = notOffered,
    .freeInstance = notOffered,
    .freeObjectPath = notOffered,
    .freeArgs = notOffered,
    .freeString = notOffered,
    .freeArray = notOffered,
    .freeDateTime = notOffered,
    .freeSelectExp = notOffered,
};

} // namespace Host
