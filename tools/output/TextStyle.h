// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What lines of text may consist of.

#pragma once

#include <cstddef>

namespace Tools {

struct TextStyle {
    std::size_t width; // in columns
    bool isColored;
    bool isUtf8; // else the text is ASCII
};

} // namespace Tools
