// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/objectmanagers/FormerRelease.h"

#include "tests/packaging/Installation.h"

#include <utility>
#include <vector>

namespace Testing {

namespace fs = std::filesystem;

namespace {

const fs::path libraryFolder = "lib/cmpi";
const fs::path classFolder = "share/sensor-profile";
constexpr const char* sensorProvider = "libSensorProfileProvider.so";
constexpr const char* systemProvider = "libComputerSystemProvider.so";

} // namespace

FormerRelease::FormerRelease()
{
    fs::create_directories(prefix_ / libraryFolder);
    fs::create_directories(prefix_ / classFolder);
    for (const auto& [from, to] : {std::pair(sensorProvider, sensorProvider),
             {"libSensorProfileComputerSystem.so", systemProvider}})
        fs::copy_file(movedInstallation() / libraryFolder / from, prefix_ / libraryFolder / to);
    fs::copy(SENSOR_PROFILE_SOURCE_DIR "/tests/data/release-0.2.0", prefix_ / classFolder,
        fs::copy_options::recursive);
}

void FormerRelease::registerIn(
    const InstalledManager& manager, const std::string& providerFolder) const
{
    for (const char* const name : {sensorProvider, systemProvider})
        fs::create_symlink(prefix_ / libraryFolder / name, fs::path(providerFolder) / name);
    const std::string share = prefix_ / classFolder;
    const std::vector<std::string> files = {
        share + "/sensor-profile-computer-system.mof", share + "/sensor-profile.mof"};
    if (&manager == &InstalledManager::openPegasus()) {
        for (const std::string& file : files)
            manager.command("cimmof", {"-uc", "-n", "root/cimv2", file});
        manager.command("cimmof",
            {"-n", "root/PG_InterOp", share + "/registration/sensor-profile-registration.mof"});
        return;
    }
    const std::string stage = manager.folder() + "/var/lib/sfcb/stage";
    for (const std::string& file : files)
        manager.command("sfcbstage", {"-s", stage, "-n", "root/cimv2", "-r",
                                         share + "/registration/sensor-profile.reg", file});
    manager.command("sfcbrepos", {"-s", stage, "-f"});
}

void FormerRelease::upgrade() const
{
    fs::remove_all(prefix_);
    fs::copy(movedInstallation(), prefix_, fs::copy_options::recursive);
    fs::create_symlink(
        "libSensorProfileComputerSystem.so", prefix_ / libraryFolder / systemProvider);
}

} // namespace Testing
