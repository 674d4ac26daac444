// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/ProviderFile.h"

#include "tools/Installation.h"

#include <array>
#include <stdexcept>
#include <vector>

namespace Tools {

namespace {

constexpr const char* sensorLibrary = "libSensorProfileProvider.so";
constexpr const char* computerSystemLibrary = "libSensorProfileComputerSystem.so";

// Relative to the prefix of the installation. Object managers load providers from `cmpi` folders;
// SENSOR_PROFILE_ARCHITECTURE is Debian's name, such as x86_64-linux-gnu.
constexpr std::array folders = {"lib", "lib/cmpi", "lib/" SENSOR_PROFILE_ARCHITECTURE,
    "lib/" SENSOR_PROFILE_ARCHITECTURE "/cmpi", "lib64", "lib64/cmpi"};

std::vector<std::filesystem::path> places()
{
    const auto prefix = installationPrefix();
    std::vector<std::filesystem::path> found;
    found.reserve(folders.size());
    for (const char* const folder : folders)
        found.push_back(prefix / folder);
    return found;
}

std::optional<std::string> find(const char* library)
{
    for (const std::filesystem::path& place : places()) {
        std::error_code unreadable;
        if (std::filesystem::exists(place / library, unreadable))
            return (place / library).string();
    }
    return std::nullopt;
}

} // namespace

std::string findProviderFile()
{
    if (auto file = find(sensorLibrary))
        return *std::move(file);
    std::string looked;
    for (const std::filesystem::path& place : places())
        looked += (looked.empty() ? "" : ", ") + place.string();
    throw std::runtime_error(std::string(sensorLibrary) + " is in none of " + looked +
                             "; --provider FILE says where it is");
}

std::optional<std::string> findComputerSystemProviderFile()
{
    return find(computerSystemLibrary);
}

} // namespace Tools
