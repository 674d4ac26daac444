// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/Emphasis.h"

namespace Tools {

namespace {

// Returns the control sequence Select Graphic Rendition (ECMA-48), in the terminal's own palette.
const char* startOf(Emphasis emphasis)
{
    switch (emphasis) {
    case Emphasis::heading:
        return "\x1B[1m";
    case Emphasis::faint:
        return "\x1B[2m";
    case Emphasis::good:
        return "\x1B[32m";
    case Emphasis::warning:
        return "\x1B[33m";
    case Emphasis::critical:
        return "\x1B[1;31m";
    case Emphasis::none:
        break;
    }
    return "";
}

} // namespace

std::string emphasized(const std::string& text, Emphasis emphasis, bool isColored)
{
    if (!isColored || emphasis == Emphasis::none || text.empty())
        return text;
    return startOf(emphasis) + text + "\x1B[0m";
}

} // namespace Tools
