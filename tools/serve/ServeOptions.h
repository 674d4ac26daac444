// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the command line and the configuration file can say about serving.

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

struct ServeOptions {
    Host::Http::ListenWishes listen;
    std::optional<std::string> certificate;
    std::optional<std::string> key;
    std::optional<std::string> passwords;
    std::optional<std::string> user;
    std::optional<std::string> configuration;
    Host::Http::Limits http;
    Host::OperationLimits operations;
    std::chrono::seconds gracePeriod{20};

    // The object must outlive the parser.
    void addTo(CLI::App& parser);

    // To be called when the command line was read: reads the configuration file where there is
    // one. Throws UsageError for a mistake in it and for options that do not go together, and
    // std::runtime_error when it cannot be read.
    void complete(CLI::App& parser);
};

} // namespace Tools
