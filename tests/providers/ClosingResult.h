// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/broker/Result.h"
#include "tests/support/LogCapture.h"

#include <vector>

namespace Testing {

inline bool isExitMark(const LogLine& line)
{
    return line.function == "markProviderExit";
}

// A result that records the log when it is closed. Only one may exist at a time.
class ClosingResult {
public:
    explicit ClosingResult(const LogCapture& capture) : capture_(capture)
    {
        inForce_ = this;
        functions_.returnDone = [](const CMPIResult* closed) {
            const CMPIStatus status = Host::Result::functions.returnDone(closed);
            inForce_->linesBefore = inForce_->capture_.log();
            return status;
        };
    }
    ClosingResult(const ClosingResult&) = delete;
    ClosingResult& operator=(const ClosingResult&) = delete;

    const CMPIResult* handle() const { return &handle_; }

    Host::CollectedResult answer;
    std::vector<LogLine> linesBefore;

private:
    inline static ClosingResult* inForce_ = nullptr;
    const LogCapture& capture_;
    Host::Result result_{answer};
    CMPIResultFT functions_ = Host::Result::functions;
    CMPIResult handle_{result_.handle()->hdl, &functions_};
};

} // namespace Testing
