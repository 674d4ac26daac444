// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/page/WebFiles.h"

#include "host/broker/Names.h"
#include "host/http/ResourceCheck.h"

#include <zlib.h>

#include <algorithm>
#include <array>
#include <fstream>
#include <iterator>
#include <optional>
#include <stdexcept>
#include <string_view>
#include <utility>

namespace Tools {

namespace {

constexpr const char* policy =
    "default-src 'none'; script-src 'self'; style-src 'self'; connect-src 'self'; "
    "img-src 'self'; base-uri 'none'; form-action 'self'; frame-ancestors 'none'";

// The content types of files by the ends of their names; other files are not served.
constexpr std::array<std::pair<std::string_view, const char*>, 4> contentTypes = {{
    {".js", "text/javascript; charset=utf-8"},
    {".css", "text/css; charset=utf-8"},
    {".json", "application/json"},
    {".svg", "image/svg+xml"},
}};

const char* contentTypeOf(std::string_view name)
{
    const auto* const found = std::find_if(contentTypes.begin(), contentTypes.end(),
        [&](const auto& each) { return name.ends_with(each.first); });
    return found == contentTypes.end() ? nullptr : found->second;
}

std::string readFile(const std::filesystem::path& path)
{
    std::ifstream file(path, std::ios::binary);
    std::string content{std::istreambuf_iterator<char>(file), {}};
    if (!file)
        throw std::runtime_error(path.string() + ": cannot be read");
    return content;
}

FileResource::Form formOf(const std::filesystem::path& path)
{
    auto content = std::make_shared<const std::string>(readFile(path));
    const auto sum =
        ::crc32_z(0, reinterpret_cast<const unsigned char*>(content->data()), content->size());
    auto entityTag = '"' + std::to_string(content->size()) + "-" + std::to_string(sum) + '"';
    return {std::move(content), std::move(entityTag)};
}

bool acceptsGzip(const Host::Http::RequestHead& head)
{
    const auto codings = Host::Http::weightedElements(head, "Accept-Encoding");
    return std::any_of(codings.begin(), codings.end(),
        [](const auto& each) { return Host::equalNames(each.value, "gzip") && each.weight > 0; });
}

// Returns whether If-None-Match has the entity tag. The comparison is weak (RFC 9110, 8.8.3.2).
bool isKnown(const Host::Http::RequestHead& head, const std::string& entityTag)
{
    const auto known = Host::Http::weightedElements(head, "If-None-Match");
    return std::any_of(known.begin(), known.end(), [&](const auto& each) {
        const bool isWeak = each.value.starts_with("W/");
        return each.value == "*" || each.value.substr(isWeak ? 2 : 0) == entityTag;
    });
}

} // namespace

std::vector<Host::Http::HeaderField> pageFields(const char* contentType, const char* cacheControl)
{
    return {{"Content-Type", contentType}, {"Cache-Control", cacheControl},
        {"Content-Security-Policy", policy}, {"Cross-Origin-Resource-Policy", "same-origin"},
        {"Referrer-Policy", "no-referrer"}, {"X-Content-Type-Options", "nosniff"}};
}

FileResource::FileResource(const char* contentType, Form plain, Form compressed)
    : contentType_(contentType), plain_(std::move(plain)), compressed_(std::move(compressed))
{
}

Host::Http::Representation FileResource::represent(const Host::Http::RequestHead& head)
{
    const bool isCompressed = compressed_.content && acceptsGzip(head);
    const Form& form = isCompressed ? compressed_ : plain_;
    auto fields = pageFields(contentType_, "no-cache");
    fields.push_back({"ETag", form.entityTag});
    fields.push_back({"Vary", "Accept-Encoding"});
    if (isCompressed)
        fields.push_back({"Content-Encoding", "gzip"});
    // A response with status 304 has the Content-Length of the content that it does not send (RFC
    // 9110, 8.6).
    return {std::move(fields), form.content, isKnown(head, form.entityTag) ? 304U : 200U};
}

WebFiles::WebFiles(const std::filesystem::path& folder)
{
    for (const auto& entry : std::filesystem::recursive_directory_iterator(folder)) {
        const std::filesystem::path& path = entry.path();
        if (!entry.is_regular_file() || path.extension() == ".gz")
            continue;
        const std::string name = path.lexically_relative(folder).string();
        const std::filesystem::path compressed = path.string() + ".gz";
        files_.try_emplace(name, contentTypeOf(name), formOf(path),
            std::filesystem::exists(compressed) ? formOf(compressed) : FileResource::Form{});
    }
}

void WebFiles::addTo(Host::Http::Resources& resources)
{
    for (auto& [name, file] : files_)
        if (contentTypeOf(name) != nullptr)
            resources.emplace("/web/" + name, file);
}

std::vector<std::string> WebFiles::namesIn(const std::string& folder) const
{
    std::vector<std::string> names;
    for (const auto& [name, file] : files_)
        if (name.starts_with(folder + "/"))
            names.push_back(name);
    if (names.empty())
        throw std::runtime_error("the folder " + folder + " is missing");
    return names;
}

const std::string& WebFiles::contentOf(const std::string& name) const
{
    const auto found = files_.find(name);
    if (found == files_.end())
        throw std::runtime_error("the file " + name + " is missing");
    return found->second.content();
}

} // namespace Tools
