// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// In which form an answer is printed.

#pragma once

#include "tools/commands/ColorOption.h"
#include "tools/output/Terminal.h"

#include <cstddef>

namespace CLI {
class App;
}

namespace Tools {

class DisplayOptions {
public:
    // Adds --json and --color; the object must outlive the parser.
    void addTo(CLI::App& parser);

    bool isJson() const { return isJson_; }
    bool isColored() const { return color_.isColored(); }
    std::size_t width() const { return outputWidth(); }

private:
    bool isJson_ = false;
    ColorOption color_;
};

} // namespace Tools
