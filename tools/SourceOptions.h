// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Which machine is shown, and through which provider libraries.

#pragma once

#include "tools/cim/ProviderClient.h"

#include <optional>
#include <string>

namespace CLI {
class App;
}

namespace Tools {

class SourceOptions {
public:
    // Adds --model; the object must outlive the parser.
    void addModel(CLI::App& parser);
    // Adds --provider; likewise.
    void addProvider(CLI::App& parser);

    const std::optional<std::string>& model() const { return model_; }

    // Makes the model file, if one was given, the machine of this process: to be called before
    // a provider is loaded and before there are other threads. Throws std::runtime_error
    // naming the file, the place in it and the reason when it is no model.
    void selectMachine() const;

    // Throws std::runtime_error when no library was given and none is found.
    ProviderFiles providerFiles() const;

private:
    std::optional<std::string> model_;
    std::optional<std::string> provider_;
};

} // namespace Tools
