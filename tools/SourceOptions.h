// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The options that select the machine and the provider libraries.

#pragma once

#include "platform/instrumentation/SourceList.h"
#include "tools/cim/ProviderClient.h"

#include <optional>
#include <string>
#include <vector>

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

    // Returns the sources of sensors. Throws std::runtime_error for a malformed list of them.
    // REQUIRES: selectMachine() was called.
    static std::vector<Vorn::SourceEntry> sources();

    // Returns whether the sensors are those of the kernel. REQUIRES: selectMachine() was called.
    static bool readsHwmon();

    // Returns when the sensors of a management controller were read, such as "read 4 s ago": the
    // oldest of several collections, without those that cannot be read. Returns an empty text where
    // there is none.
    static std::string ageOfCollection();

    // Returns the reasons why sources cannot be used, of which the provider publishes no sensors.
    // Skips the chips where they are listed, since that is expensive. Opens the others again, which
    // may have changed since the provider read them. REQUIRES: selectMachine() was called.
    static std::vector<std::string> failures(bool areChipsListed);

    // Throw std::runtime_error when no library is given and none is found. The second names the
    // library of the sensors alone, which is all that sensors need: the other one takes long to
    // load.
    ProviderFiles providerFiles() const;
    ProviderFiles sensorProviderFile() const;

private:
    std::optional<std::string> model_;
    std::optional<std::string> provider_;
};

} // namespace Tools
