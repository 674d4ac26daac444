// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Finds the processes in which object managers run our providers.

#pragma once

#include <sys/types.h>

#include <filesystem>
#include <fstream>
#include <set>
#include <string>

namespace Testing {

inline std::filesystem::path processFolder(::pid_t process)
{
    return "/proc/" + std::to_string(process);
}

// Returns whether a process has mapped files whose names hold all these texts; one that ends has
// none.
inline bool hasMapped(const std::filesystem::path& folder, std::set<std::string> texts)
{
    std::ifstream maps(folder / "maps");
    for (std::string line; std::getline(maps, line) && !texts.empty();)
        std::erase_if(texts, [&](const std::string& text) { return line.find(text) != line.npos; });
    return texts.empty();
}

// Returns the processes that run programs of this folder and have loaded a library of ours.
inline std::set<::pid_t> agentsBelow(const std::string& folder)
{
    std::set<::pid_t> agents;
    for (const auto& entry : std::filesystem::directory_iterator("/proc")) {
        const std::string name = entry.path().filename();
        if (name.find_first_not_of("0123456789") == std::string::npos &&
            hasMapped(entry.path(), {' ' + folder + '/', "/libSensorProfile"}))
            agents.insert(std::stoi(name));
    }
    return agents;
}

} // namespace Testing
