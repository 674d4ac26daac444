// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/ServiceManager.h"

#include <systemd/sd-daemon.h>

namespace Tools {

namespace {

const char* textOf(ServiceState state)
{
    switch (state) {
    case ServiceState::ready:
        return "READY=1";
    case ServiceState::reloading:
        return "RELOADING=1";
    case ServiceState::stopping:
        break;
    }
    return "STOPPING=1";
}

} // namespace

void tellServiceManager(ServiceState state) noexcept
{
    // Nobody who asked for it can be told that it failed.
    (void)::sd_notify(0, textOf(state));
}

} // namespace Tools
