// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/SourceList.h"

#include <stdexcept>
#include <string_view>

namespace Vorn {

namespace {

// Returns the position of the comma that ends the entry which begins at `from`, or the end of the
// list.
std::size_t endOfEntry(const std::string& list, std::size_t from)
{
    for (std::size_t at = from; at < list.size(); ++at) {
        if (list[at] == ',')
            return at;
        if (list[at] == '\\')
            ++at;
    }
    return list.size();
}

SourceEntry parseEntry(const std::string& text, const std::string& list)
{
    SourceEntry entry{text, {}, {}};
    std::string* part = &entry.scheme;
    for (std::size_t at = 0; at < text.size(); ++at) {
        if (text[at] == ':' && part == &entry.scheme) {
            part = &entry.argument;
            continue;
        }
        if (text[at] == '\\' && ++at == text.size())
            throw std::runtime_error("source \"" + text + "\" ends in a lone backslash");
        part->push_back(text[at]);
    }
    if (entry.scheme.empty())
        throw std::runtime_error("source \"" + text + "\" in \"" + list + "\" has no name");
    return entry;
}

} // namespace

std::vector<SourceEntry> parseSourceList(const std::string& list)
{
    std::vector<SourceEntry> entries;
    for (std::size_t from = 0; from <= list.size();) {
        const std::size_t end = endOfEntry(list, from);
        entries.push_back(parseEntry(list.substr(from, end - from), list));
        from = end + 1;
    }
    return entries;
}

std::string formatSourceEntry(const std::string& scheme, const std::string& argument)
{
    std::string entry = scheme + ":";
    for (const char character : argument) {
        if (character == ',' || character == '\\')
            entry.push_back('\\');
        entry.push_back(character);
    }
    return entry;
}

} // namespace Vorn
