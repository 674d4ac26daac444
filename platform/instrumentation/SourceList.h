// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The text form of a list of sources, as VORN_INSTRUMENTATION carries it: `scheme[:argument]`
// entries with commas between them. A backslash removes the special meaning of the character after
// it, so that a file name may contain a comma: `model:/srv/a\,b.json`.

#pragma once

#include <string>
#include <vector>

namespace Vorn {

struct SourceEntry {
    std::string text; // as it is in the list
    std::string scheme;
    std::string argument; // empty when there is none
};

// Throws std::runtime_error naming the entry that is empty or ends in a lone backslash.
std::vector<SourceEntry> parseSourceList(const std::string& list);

// Returns the entry that parseSourceList() reads back as this scheme and argument.
std::string formatSourceEntry(const std::string& scheme, const std::string& argument);

} // namespace Vorn
