// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The form in which an answer is printed.

#pragma once

#include <string>

namespace CLI {
class App;
}

namespace Tools {

// The object must outlive the parser.
class DisplayOptions {
public:
    void addJson(CLI::App& parser);
    void addColor(CLI::App& parser);

    bool isJson() const { return isJson_; }
    // Returns whether the option, or else the environment, selects colors on standard output.
    bool isColored() const;

private:
    bool isJson_ = false;
    std::string color_ = "auto";
};

} // namespace Tools
