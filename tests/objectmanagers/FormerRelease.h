// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An installation of release 0.2.0 that is upgraded to this build.

#pragma once

#include "tests/objectmanagers/InstalledManager.h"
#include "tests/support/TemporaryFolder.h"

#include <filesystem>
#include <string>

namespace Testing {

// Its classes and registrations are those of the release, in tests/data/release-0.2.0. Its
// libraries are those of this build, of which the second has its former name.
class FormerRelease {
public:
    static constexpr const char* version = "0.1.0"; // of its classes

    FormerRelease();

    // Runs the commands that sensor-profile-register of the release ran. They link the libraries
    // into the folder.
    void registerIn(const InstalledManager& manager, const std::string& providerFolder) const;

    // Replaces the installed files by those of this build. As in an upgrade of the Debian package,
    // the former name of the library becomes a link to the library.
    void upgrade() const;

    const std::filesystem::path& prefix() const { return prefix_; }

private:
    TemporaryFolder folder_;
    std::filesystem::path prefix_ = folder_.path() / "installation";
};

} // namespace Testing
