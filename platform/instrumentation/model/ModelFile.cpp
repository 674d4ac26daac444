// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/ModelFile.h"

#include "platform/instrumentation/SourceList.h"
#include "platform/instrumentation/model/ModelCache.h"

namespace Vorn {

void checkModelFile(const std::string& path)
{
    ModelCache::instance().load(path);
}

std::string modelFileEntry(const std::string& path)
{
    return formatSourceEntry("model", path);
}

} // namespace Vorn
