// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/Installation.h"

#include <unistd.h>

#include <cerrno>
#include <system_error>

namespace Tools {

namespace {

// Relative to the prefix; in a build, the programs are beside sensorctl.
constexpr const char* programFolder = "libexec/sensor-profile";

std::filesystem::path folderOfExecutable()
{
    return std::filesystem::read_symlink("/proc/self/exe").parent_path();
}

} // namespace

std::filesystem::path installationPrefix()
{
    const auto parent = folderOfExecutable().parent_path();
    return folderOfExecutable() == parent.parent_path() / programFolder ? parent.parent_path()
                                                                        : parent;
}

void executeProgram(const char* name, std::vector<std::string> words)
{
    const auto installed = installationPrefix() / programFolder / name;
    const std::string file =
        std::filesystem::exists(installed) ? installed : folderOfExecutable() / name;
    std::vector<char*> arguments;
    arguments.reserve(words.size() + 1);
    for (std::string& word : words)
        arguments.push_back(word.data());
    arguments.push_back(nullptr);
    ::execv(file.c_str(), arguments.data());
    throw std::system_error(errno, std::generic_category(), file);
}

} // namespace Tools
