// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/JsonText.h"

#include "platform/text/Utf8.h"
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
        const Text::Character character = Text::firstCharacter(json);
        if (character.code <= lastOfAscii || !isUnprintable(character.code)) {
            result += json.substr(0, character.size);
        } else {
            std::array<char, 16> escape{};
            std::snprintf(
                escape.data(), escape.size(), "\\u%04x", static_cast<unsigned>(character.code));
            result += escape.data();
        }
        json.remove_prefix(character.size);
    }
    return result;
}

} // namespace Tools
