// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Message catalogs that no translator would write.

#pragma once

#include "tests/support/TemporaryFolder.h"

#include <map>
#include <string>

namespace Testing {

// The bytes of a .mo file with a UTF-8 header and the given texts by message identifier.
std::string messageFile(const std::map<std::string, std::string>& texts,
    const std::string& header = "Content-Type: text/plain; charset=UTF-8\n");

// A folder such as /usr/share/locale.
class CatalogRoot {
public:
    std::string path() const { return folder_.path().string(); }

    void write(const std::string& language, const std::string& bytes,
        const std::string& domain = "sensor-profile") const
    {
        const std::string folder = language + "/LC_MESSAGES";
        std::filesystem::create_directories(folder_.path() / folder);
        folder_.write(folder + "/" + domain + ".mo", bytes);
    }

private:
    TemporaryFolder folder_;
};

} // namespace Testing
