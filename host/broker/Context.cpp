// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Context.h"

#include "host/broker/Slot.h"

namespace Host {

const CMPIContextFT Context::functions = {
    .ftVersion = CMPIVersion200,
    .release = notOffered,
    .clone = notOffered,
    .getEntry = notOffered,
    .getEntryAt = notOffered,
    .getEntryCount = notOffered,
    .addEntry = notOffered,
};

} // namespace Host
