// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/ipmi/IpmiSource.h"

#include <optional>
#include <string>
#include <vector>

namespace CLI {
class App;
}

namespace Tools {

// Workarounds, for controllers that deviate from IPMI.
inline constexpr const char* discreteReading = "discretereading";
inline constexpr const char* ignoreScanningDisabled = "ignorescanningdisabled";
inline constexpr const char* assumeBmcOwner = "assumebmcowner";

// The options of `sensorctl collect`.
struct CollectOptions {
    std::string file = Vorn::defaultCollection;
    bool isOnce = false;
    bool isOnlyPresent = false;
    unsigned interval = 10; // in seconds
    std::vector<std::string> workarounds;

    // Adds the options; the object must outlive the parser.
    void addTo(CLI::App& parser);

    // Reads the command line of the program. Returns its exit status where there is nothing left to
    // do: after --help, or a mistake, which it reports to standard error.
    std::optional<int> parse(int argc, const char* const* argv);

    // Returns the words of a command line with these options.
    std::vector<std::string> words() const;
};

} // namespace Tools
