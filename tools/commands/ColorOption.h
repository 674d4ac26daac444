// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Whether an answer is colored.

#pragma once

#include <string>

namespace CLI {
class App;
}

namespace Tools {

class ColorOption {
public:
    // Adds --color; the object must outlive the parser.
    void addTo(CLI::App& parser);

    bool isColored() const;

private:
    std::string color_ = "auto";
};

} // namespace Tools
