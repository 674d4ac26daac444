// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The classes of the embedded object manager, compiled from the shipped files.

#pragma once

#include "host/repository/Compiler.h"

#include <memory>
#include <utility>

namespace Testing {

inline std::unique_ptr<const Host::Repository> shippedClasses()
{
    Host::Compiler compiler;
    compiler.compileFile(SENSOR_PROFILE_SOURCE_DIR "/schema/host.mof", "root/cimv2");
    return std::move(compiler).finish();
}

} // namespace Testing
