// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What a shared library exports, as the linker's tools see it.

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

// The names in `nm`'s lines of value, type and name.
inline std::vector<std::string> exportedNames(const std::string& library)
{
    std::istringstream lines(outputOf("nm -D --defined-only '" + library + "'"));
    std::vector<std::string> names;
    for (std::string value, type, name; lines >> value >> type >> name;)
        names.push_back(name);
    return names;
}

} // namespace Testing
