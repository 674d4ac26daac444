// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Files and folders of sysfs.

#pragma once

#include <dirent.h>

#include <array>
#include <fstream>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Tools {

inline constexpr const char* hwmonFolder = "/sys/class/hwmon";

// Calls the visitor with the names in a folder that are not hidden, in the kernel's order; not at
// all when it cannot be read.
template <typename Visitor>
void visitEntries(const std::string& folder, const Visitor& visit)
{
    const std::unique_ptr<DIR, int (*)(DIR*)> directory(::opendir(folder.c_str()), ::closedir);
    if (!directory)
        return;
    while (const dirent* const entry = ::readdir(directory.get()))
        if (entry->d_name[0] != '.')
            visit(std::string_view(entry->d_name));
}

// Returns these names.
inline std::vector<std::string> entriesOf(const std::string& folder)
{
    std::vector<std::string> names;
    visitEntries(folder, [&](std::string_view name) { names.emplace_back(name); });
    return names;
}

// Returns the content of an attribute without line feeds at its end; nothing when it cannot be
// read.
inline std::optional<std::string> contentOf(const std::string& file)
{
    std::ifstream in(file, std::ios::binary);
    std::array<char, 4096> content{}; // attributes are no longer
    in.read(content.data(), content.size());
    if (in.bad() || !in.eof())
        return std::nullopt;
    std::string text(content.data(), static_cast<std::size_t>(in.gcount()));
    text.erase(text.find_last_not_of('\n') + 1);
    return text;
}

} // namespace Tools
