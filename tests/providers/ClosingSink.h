// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Reads the log at the moment in which a result is closed.

#pragma once

#include "host/broker/CollectedResult.h"
#include "tests/support/LogCapture.h"

#include <vector>

namespace Testing {

inline bool isExitMark(const LogLine& line)
{
    return line.function == "markProviderExit";
}

class ClosingSink : public Host::CollectedResult {
public:
    explicit ClosingSink(const LogCapture& capture) : capture_(capture) {}

    void done() override
    {
        Host::CollectedResult::done();
        linesBefore = capture_.log();
    }

    std::vector<LogLine> linesBefore;

private:
    const LogCapture& capture_;
};

} // namespace Testing
