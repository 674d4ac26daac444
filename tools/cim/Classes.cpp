// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/Classes.h"

#include "host/repository/Compiler.h"
#include "tools/cim/ProviderClient.h"

#include <filesystem>
#include <utility>

namespace Tools {

std::unique_ptr<const Host::Repository> compileClasses()
{
    const auto here = std::filesystem::read_symlink("/proc/self/exe").parent_path();
    Host::Compiler compiler;
    compiler.compileFile((here / "../share/sensor-profile/host.mof").lexically_normal(), nameSpace);
    return std::move(compiler).finish();
}

} // namespace Tools
