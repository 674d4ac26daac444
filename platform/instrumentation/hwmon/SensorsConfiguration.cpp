// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/SensorsConfiguration.h"

#include "platform/instrumentation/RegularFile.h"

#include <algorithm>
#include <stdexcept>
#include <system_error>

namespace Vorn::Hwmon {

namespace fs = std::filesystem;

namespace {

constexpr const char* safeStart = "chip \"none-isa-ffff\"\n";

constexpr std::size_t maximumBytes = std::size_t{1} << 20U;

int lineCount(const std::string& text)
{
    return static_cast<int>(std::count(text.begin(), text.end(), '\n'));
}

bool isHidden(const fs::path& path)
{
    return path.filename().native().starts_with('.');
}

// Returns the regular files of the folder that are not hidden, sorted by name. Throws
// std::system_error when the process has too many open files to list them.
std::vector<fs::path> visibleFiles(const fs::path& folder)
{
    std::vector<fs::path> files;
    std::error_code error;
    for (fs::directory_iterator entry(folder, error), end; !error && entry != end;
         entry.increment(error)) {
        std::error_code gone;
        if (!isHidden(entry->path()) && entry->is_regular_file(gone))
            files.push_back(entry->path());
    }
    if (error == std::errc::too_many_files_open ||
        error == std::errc::too_many_files_open_in_system)
        throw std::system_error(error, folder.native());
    std::sort(files.begin(), files.end());
    return files;
}

} // namespace

std::vector<fs::path> configurationFiles()
{
    std::vector<fs::path> files = visibleFiles("/etc/sensors.d");
    for (const char* name : {"/etc/sensors3.conf", "/etc/sensors.conf"}) {
        std::error_code ignored;
        if (fs::exists(name, ignored)) {
            files.insert(files.begin(), name);
            break;
        }
    }
    return files;
}

SensorsConfiguration::SensorsConfiguration() : text_(safeStart)
{
    for (const fs::path& file : configurationFiles())
        append(file);
}

void SensorsConfiguration::append(const fs::path& file)
{
    parts_.push_back({file.string(), lineCount(text_) + 1});
    try {
        text_ += readRegularFile(file, maximumBytes).text;
    } catch (const std::runtime_error& error) {
        throw std::runtime_error("sensors configuration " + file.string() + ": " + error.what());
    }
    // Neither an unfinished line nor one that a backslash continues reaches into the next file.
    text_ += "\n\n";
}

std::string SensorsConfiguration::place(int line) const
{
    const auto after = std::find_if(parts_.begin(), parts_.end(),
        [line](const Part& candidate) { return candidate.firstLine > line; });
    if (after == parts_.begin())
        return "sensors configuration";
    const Part& part = *std::prev(after);
    return "File " + part.file + ", line " + std::to_string(line - part.firstLine + 1);
}

} // namespace Vorn::Hwmon
