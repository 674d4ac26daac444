// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/OwnFolder.h"

#include <filesystem>
#include <system_error>

#include <dlfcn.h>
#include <link.h>

namespace Vorn {

std::string ownFolder()
{
    Dl_info info{};
    void* entry = nullptr;
    const auto* const here = reinterpret_cast<const void*>(&ownFolder);
    if (::dladdr1(here, &info, &entry, RTLD_DL_LINKMAP) == 0 || entry == nullptr)
        return {};
    // The dynamic linker knows the program itself by an empty name.
    const std::string name = static_cast<const link_map*>(entry)->l_name;
    std::error_code error;
    const auto file = std::filesystem::canonical(name.empty() ? "/proc/self/exe" : name, error);
    return error ? std::string() : file.parent_path().string();
}

} // namespace Vorn
