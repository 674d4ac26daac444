// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/packaging/Installation.h"

#include "tests/tools/ChildProcess.h"

#include <algorithm>
#include <stdexcept>

namespace Testing {

namespace fs = std::filesystem;

namespace {

class MovedInstallation {
public:
    MovedInstallation()
    {
        install({"--prefix", (folder_.path() / "made/for").string()});
        fs::create_directories(folder_.path() / "moved");
        fs::rename(folder_.path() / "made/for", prefix_);
    }

    const fs::path& prefix() const { return prefix_; }

private:
    TemporaryFolder folder_;
    fs::path prefix_ = folder_.path() / "moved/to";
};

} // namespace

void install(const std::vector<std::string>& arguments,
    const std::map<std::string, std::string>& environment)
{
    std::vector<std::string> command = {"--install", SENSOR_PROFILE_BINARY_DIR};
    command.insert(command.end(), arguments.begin(), arguments.end());
    const Ended ended = run(command, {.program = SENSOR_PROFILE_CMAKE, .environment = environment});
    if (ended.code != 0)
        throw std::runtime_error("cmake --install: " + ended.out + ended.err);
}

std::vector<std::string> filesBelow(const fs::path& folder)
{
    std::vector<std::string> files;
    for (const fs::directory_entry& entry : fs::recursive_directory_iterator(folder))
        if (!entry.is_directory() || entry.is_symlink())
            files.push_back(entry.path().lexically_relative(folder).string());
    std::sort(files.begin(), files.end());
    return files;
}

const fs::path& movedInstallation()
{
    static const MovedInstallation installation;
    return installation.prefix();
}

} // namespace Testing
