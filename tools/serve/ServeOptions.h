// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Limits.h"
#include "host/http/ListenPolicy.h"
#include "host/operations/OperationLimits.h"

#include <chrono>
#include <optional>
#include <string>

namespace CLI {
class App;
}

namespace Tools {

// The options of `sensorctl serve`, with their defaults.
struct ServeOptions {
    Host::Http::ListenWishes listen;
    std::optional<std::string> certificate;
    std::optional<std::string> key;
    std::optional<std::string> passwords;
    std::optional<std::string> user;
    std::optional<std::string> compatible; // the exporter whose metrics are added
    std::optional<std::string> configuration;
    std::optional<std::string> history; // the folder of the history; none for memory only
    bool isHistoryKept = true;
    bool isCheck = false; // whether only the options and their files are checked
    Host::Http::Limits http;
    Host::OperationLimits operations;
    std::chrono::seconds gracePeriod{20};

    // Adds the options to a parser, which this object must outlive.
    void addTo(CLI::App& parser);

    // Reads the configuration file, if there is one. Throws UsageError for a mistake in it and for
    // options that contradict each other, and std::runtime_error when it cannot be read.
    // REQUIRES: the parser has parsed the command line.
    void complete(CLI::App& parser);
};

} // namespace Tools
