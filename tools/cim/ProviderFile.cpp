// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/ProviderFile.h"

#include <array>
#include <filesystem>
#include <stdexcept>

namespace Tools {

namespace {

constexpr const char* fileName = "libSensorProfileProvider.so";

// From the folder of the tool's executable; object managers look for providers in `cmpi`
// folders. The architecture is Debian's name for it, such as x86_64-linux-gnu.
constexpr std::array folders = {"../lib", "../lib/cmpi", "../lib/" SENSOR_PROFILE_ARCHITECTURE,
    "../lib/" SENSOR_PROFILE_ARCHITECTURE "/cmpi", "../lib64", "../lib64/cmpi"};

} // namespace

std::string findProviderFile()
{
    const auto here = std::filesystem::read_symlink("/proc/self/exe").parent_path();
    std::string looked;
    for (const char* const folder : folders) {
        const auto place = (here / folder).lexically_normal();
        std::error_code unreadable;
        if (std::filesystem::exists(place / fileName, unreadable))
            return (place / fileName).string();
        looked += (looked.empty() ? "" : ", ") + place.string();
    }
    throw std::runtime_error(
        std::string(fileName) + " is in none of " + looked + "; --provider FILE says where it is");
}

} // namespace Tools
