// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Resource.h"

#include <filesystem>
#include <map>
#include <memory>
#include <string>
#include <vector>

namespace Tools {

// A file of the page, which clients may keep as long as its entity tag is the same (RFC 9110, 8.8.3
// and 13.1.2). It is sent compressed where the client accepts that.
class FileResource : public Host::Http::Resource {
public:
    struct Form {
        std::shared_ptr<const std::string> content; // null where there is no such form
        std::string entityTag;
    };

    FileResource(const char* contentType, Form plain, Form compressed);

    Host::Http::Representation represent(const Host::Http::RequestHead& head) override;

    const std::string& content() const { return *plain_.content; }

private:
    const char* contentType_;
    Form plain_;
    Form compressed_;
};

// The files of the page, held in memory.
class WebFiles {
public:
    // Reads all files of the folder and the folders in it, each with its compressed form (`.gz`)
    // where that is beside it. Throws std::runtime_error with the file and the reason.
    explicit WebFiles(const std::filesystem::path& folder);

    // Adds those that are served, as /web/ and their names. They belong to this object.
    void addTo(Host::Http::Resources& resources);

    // Returns the names in a folder such as "languages". Throws std::runtime_error for none.
    std::vector<std::string> namesIn(const std::string& folder) const;
    // Throws std::runtime_error where there is no such file.
    const std::string& contentOf(const std::string& name) const;

private:
    std::map<std::string, FileResource> files_; // by name, such as "styles/base.css"
};

// Returns the header fields of what browsers show: nothing of it, and nothing in it, is from
// elsewhere (https://www.w3.org/TR/CSP3/).
std::vector<Host::Http::HeaderField> pageFields(const char* contentType, const char* cacheControl);

} // namespace Tools
