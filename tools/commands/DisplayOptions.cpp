// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/commands/DisplayOptions.h"

#include <CLI/CLI.hpp>

namespace Tools {

void DisplayOptions::addTo(CLI::App& parser)
{
    parser.add_flag("--json", isJson_, "Print a JSON document");
    color_.addTo(parser);
}

} // namespace Tools
