// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Slot.h"

#include "host/broker/String.h"

namespace Host {

CMPIStatus makeStatus(CMPIrc code, const char* reason) noexcept
{
    try {
        if (Arena* const arena = Arena::current())
            return {code, String::make(*arena, reason).handle()};
    } catch (const std::bad_alloc&) {
        // The status is returned without a message.
    }
    return {code, nullptr};
}

} // namespace Host
