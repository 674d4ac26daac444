// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/Command.h"
#include "tools/SourceOptions.h"
#include "tools/serve/ServeOptions.h"

namespace Tools {

// The command `serve` in two programs: sensorctl checks its command line and executes
// sensorctl-serve with the same one, which serves. So the other commands of sensorctl start without
// the libraries of the server.
class ServeCommand : public Command {
public:
    explicit ServeCommand(CLI::App& tool);

    bool writesLog() const override { return true; }

protected:
    ServeOptions options_; // those of the command line
    SourceOptions source_;
};

} // namespace Tools
