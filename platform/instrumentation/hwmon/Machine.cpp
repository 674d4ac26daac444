// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/Machine.h"

#include "platform/instrumentation/hwmon/SensorsConfiguration.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>
#include <functional>
#include <memory>
#include <string_view>
#include <system_error>
#include <utility>

namespace Vorn::Hwmon {

namespace {

constexpr const char* hwmonFolder = "/sys/class/hwmon";

// Calls the visitor with a descriptor of the folder and the name of each entry that is not hidden.
// Returns whether there is such a folder. Throws std::system_error when it cannot be opened for
// another reason, such as a lack of descriptors.
template <typename Visitor>
bool visitEntries(const std::string& path, const Visitor& visit)
{
    const std::unique_ptr<DIR, int (*)(DIR*)> folder(opendir(path.c_str()), &closedir);
    if (folder == nullptr) {
        if (errno == ENOENT || errno == ENOTDIR)
            return false;
        throw std::system_error(errno, std::generic_category(), path);
    }
    while (const dirent* const entry = readdir(folder.get()))
        if (entry->d_name[0] != '.')
            visit(dirfd(folder.get()), entry->d_name);
    return true;
}

bool isUnlisted(std::string_view attribute)
{
    return attribute.ends_with("_enable") || attribute.ends_with("_label");
}

// Relative paths begin at the folder.
std::optional<FolderId> folderIdAt(int folder, const char* path)
{
    struct stat status {};
    if (fstatat(folder, path, &status, 0) != 0)
        return std::nullopt;
    return FolderId{status.st_dev, status.st_ino};
}

} // namespace

std::optional<FolderId> folderId(const std::string& path)
{
    return folderIdAt(AT_FDCWD, path.c_str());
}

Machine presentMachine()
{
    Machine machine;
    machine.hasHwmon = visitEntries(hwmonFolder, [&](int folder, const char* name) {
        if (const auto id = folderIdAt(folder, name))
            machine.chips.emplace_back(name, *id);
    });
    for (const auto& file : configurationFiles()) {
        struct stat status {};
        if (stat(file.c_str(), &status) == 0)
            machine.files.emplace_back(file.native(), stampOf(status));
    }
    return machine;
}

AttributeNames attributeNames(const Machine& machine)
{
    AttributeNames attributes;
    for (const auto& [chip, id] : machine.chips) {
        std::size_t names = 0;
        bool isNamed = false;
        std::set<std::string> unlisted;
        const auto add = [&](int, std::string_view name) {
            names += std::hash<std::string_view>{}(name);
            isNamed = isNamed || name == "name";
            if (isUnlisted(name))
                unlisted.emplace(name);
        };
        const std::string folder = std::string(hwmonFolder) + "/" + chip;
        visitEntries(folder, add);
        if (isNamed)
            attributes.unlisted.emplace(id, std::move(unlisted));
        else // old drivers have name and attributes in the folder of the device
            visitEntries(folder + "/device", add);
        attributes.fingerprint = attributes.fingerprint * 31 + names;
    }
    return attributes;
}

std::set<std::string> unlistedAttributes(const std::string& chipFolder)
{
    std::set<std::string> names;
    visitEntries(chipFolder, [&](int, std::string_view name) {
        if (isUnlisted(name))
            names.emplace(name);
    });
    return names;
}

} // namespace Vorn::Hwmon
