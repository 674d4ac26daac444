// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/Classes.h"

#include "host/repository/Compiler.h"
#include "tools/cim/ProviderClient.h"

#include <filesystem>
#include <utility>

namespace Tools {

std::filesystem::path installedFolder()
{
    const auto here = std::filesystem::read_symlink("/proc/self/exe").parent_path();
    return (here / "../share/sensor-profile").lexically_normal();
}

std::unique_ptr<const Host::Repository> compileClasses()
{
    Host::Compiler compiler;
    compiler.compileFile(installedFolder() / "host.mof", nameSpace);
    return std::move(compiler).finish();
}

} // namespace Tools
