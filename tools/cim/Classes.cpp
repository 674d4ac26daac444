// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/Classes.h"

#include "host/repository/Compiler.h"
#include "tools/Installation.h"
#include "tools/cim/ProviderClient.h"

#include <utility>

namespace Tools {

std::filesystem::path installedFolder()
{
    return installationPrefix() / "share/sensor-profile";
}

std::unique_ptr<const Host::Repository> compileClasses()
{
    Host::Compiler compiler;
    compiler.compileFile(installedFolder() / "host.mof", nameSpace);
    return std::move(compiler).finish();
}

} // namespace Tools
