// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <CLI/CLI.hpp>

#include <optional>
#include <string>

namespace Tools {

// Adds --compatible, which sets the exporter whose metrics are added.
inline void addCompatible(CLI::App& parser, std::optional<std::string>& exporter)
{
    parser
        .add_option("--compatible", exporter, "Add the metrics of another exporter: node_exporter")
        ->type_name("NAME")
        ->check(CLI::IsMember({"node_exporter"}).description(""));
}

} // namespace Tools
