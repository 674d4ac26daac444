// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/JsonText.h"

#include "tools/output/Utf8.h"

#include <array>
#include <cstdio>

namespace Tools {

std::string escapeUnprintable(std::string_view json)
{
    constexpr char32_t lastOfAscii = 0x7E;
    std::string result;
    result.reserve(json.size());
    while (!json.empty()) {
        const std::string_view before = json;
        const char32_t character = takeCharacter(json);
        if (character <= lastOfAscii || !isUnprintable(character)) {
            result += before.substr(0, before.size() - json.size());
            continue;
        }
        std::array<char, 16> escape{};
        std::snprintf(escape.data(), escape.size(), "\\u%04x", static_cast<unsigned>(character));
        result += escape.data();
    }
    return result;
}

} // namespace Tools
