// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The names that a shared library exports, read by nm.

#pragma once

#include <array>
#include <cstddef>
#include <cstdio>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

namespace Testing {

inline std::string outputOf(const std::string& command)
{
    const std::unique_ptr<FILE, int (*)(FILE*)> pipe(::popen(command.c_str(), "r"), ::pclose);
    std::string output;
    std::array<char, 4096> piece{};
    while (const std::size_t length = std::fread(piece.data(), 1, piece.size(), pipe.get()))
        output.append(piece.data(), length);
    return output;
}

// Returns the names in the output of nm, whose lines have value, type and name.
inline std::vector<std::string> exportedNames(const std::string& library)
{
    std::istringstream lines(outputOf("nm -D --defined-only '" + library + "'"));
    std::vector<std::string> names;
    for (std::string value, type, name; lines >> value >> type >> name;)
        names.push_back(name);
    return names;
}

// Returns the names that the library takes from others, with their versions.
inline std::vector<std::string> importedNames(const std::string& library)
{
    std::istringstream lines(outputOf("nm -D --undefined-only '" + library + "'"));
    std::vector<std::string> names;
    for (std::string type, name; lines >> type >> name;)
        names.push_back(name.substr(0, name.find('@')));
    return names;
}

} // namespace Testing
