// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/Machine.h"

#include "platform/instrumentation/FileStamp.h"
#include "platform/instrumentation/hwmon/SensorsConfiguration.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <functional>
#include <system_error>
#include <vector>

namespace Vorn::Hwmon {

namespace fs = std::filesystem;

namespace {

constexpr const char* hwmonFolder = "/sys/class/hwmon";

std::vector<fs::path> entriesOf(const fs::path& folder)
{
    std::vector<fs::path> entries;
    std::error_code error;
    for (fs::directory_iterator entry(folder, error), end; !error && entry != end;
         entry.increment(error))
        entries.push_back(entry->path());
    return entries;
}

std::string firstLine(const fs::path& path)
{
    std::ifstream file(path);
    std::string line;
    std::getline(file, line);
    return line;
}

// Drivers may add and remove attributes of a registered chip.
std::size_t attributesFingerprint(const fs::path& folder)
{
    std::size_t sum = 0;
    for (const fs::path& attribute : entriesOf(folder))
        sum += std::hash<std::string>{}(attribute.filename().native());
    return sum;
}

// A chip that is registered anew gets another inode. The times of a folder in sysfs are no
// criterion: the kernel sets them whenever it allocates the inode, which it may evict from its
// cache.
std::string chipFingerprint(const fs::path& folder)
{
    struct stat status {};
    if (stat(folder.c_str(), &status) != 0)
        return folder.string() + " gone\n";
    std::error_code noDevice;
    return folder.string() + ' ' + std::to_string(status.st_dev) + ' ' +
           std::to_string(status.st_ino) + ' ' + firstLine(folder / "name") + ' ' +
           fs::read_symlink(folder / "device", noDevice).string() + ' ' +
           std::to_string(attributesFingerprint(folder)) + '\n';
}

std::string fileFingerprint(const fs::path& path)
{
    struct stat status {};
    if (stat(path.c_str(), &status) != 0)
        return {};
    const FileStamp stamp = stampOf(status);
    std::string fingerprint = path.string();
    for (const auto number : {stamp.size, stamp.modified.seconds, stamp.modified.nanoseconds,
             stamp.changed.seconds, stamp.changed.nanoseconds})
        fingerprint += ' ' + std::to_string(number);
    return fingerprint + ' ' + std::to_string(stamp.device) + ' ' + std::to_string(stamp.inode) +
           '\n';
}

} // namespace

bool hasHwmon()
{
    std::error_code ignored;
    return fs::is_directory(hwmonFolder, ignored);
}

std::string machineFingerprint()
{
    std::vector<fs::path> chips = entriesOf(hwmonFolder);
    std::sort(chips.begin(), chips.end());
    std::string fingerprint = "machine\n";
    for (const fs::path& chip : chips)
        fingerprint += chipFingerprint(chip);
    for (const fs::path& file : configurationFiles())
        fingerprint += fileFingerprint(file);
    return fingerprint;
}

} // namespace Vorn::Hwmon
