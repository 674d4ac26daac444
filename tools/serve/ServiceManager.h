// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <systemd/sd-daemon.h>

namespace Tools {

// Notifies the service manager that started this process, where there is one, of a state as
// sd_notify(3) spells it. A failure has no consequence: the service manager itself is gone.
inline void notifyServiceManager(const char* state) noexcept
{
    (void)::sd_notify(0, state);
}

} // namespace Tools
