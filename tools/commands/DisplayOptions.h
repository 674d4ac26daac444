// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The form in which an answer is printed.

#pragma once

#include "tools/output/TextStyle.h"

#include <string>

namespace CLI {
class App;
}

namespace Tools {

enum class Form { table, flat, csv, json, cim };

// The object must outlive the parser.
class DisplayOptions {
public:
    void addJson(CLI::App& parser); // and --cim
    void addTables(CLI::App& parser);
    void addColor(CLI::App& parser);

    Form form() const { return form_; }
    // Returns the style for standard output by the option, the environment and the terminal.
    TextStyle style() const;

private:
    void addForm(CLI::App& parser, const char* option, Form form, const char* description);

    Form form_ = Form::table;
    std::string color_ = "auto";
};

} // namespace Tools
