// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The options that select the machine and the provider libraries.

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
    // Adds --provider; the object must outlive the parser.
    void addProvider(CLI::App& parser);

    const std::optional<std::string>& model() const { return model_; }
    const std::optional<std::string>& provider() const { return provider_; }

    // Selects the model file for this process, if one is given. Throws std::runtime_error with the
    // file, the place in it and the reason when it is no model. REQUIRES: no provider is loaded,
    // and there are no other threads.
    void selectMachine() const;

    // Throw std::runtime_error when no library is given and none is found. The second leaves out
    // the library of computer systems, which takes long to load and which sensors do not need.
    ProviderFiles providerFiles() const;
    ProviderFiles sensorProviderFile() const;

private:
    std::optional<std::string> model_;
    std::optional<std::string> provider_;
};

} // namespace Tools
