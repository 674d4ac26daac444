// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/NodeLexicon.h"

#include <compare>
#include <map>
#include <mutex>
#include <string>

namespace Vorn {

// One step of using a source. A step has failed until the same step succeeds, so that a source
// which fails for one node type only is not taken for usable when the next type is listed.
struct SourceStep {
    enum class Stage { Configuring, Opening, Listing, Reading } stage;
    NodeLexicon::NodeType type{}; // for Listing and Reading

    auto operator<=>(const SourceStep&) const = default;
};

// Reports a source that cannot be used once on the log channel, not once per request. Thread-safe.
class FailureLog {
public:
    // Returns the record of this process.
    static FailureLog& instance();

    // Writes a line, unless a step of this entry is on record with the same reason.
    void failed(const std::string& entry, SourceStep step, const std::string& reason);

    // Removes the step from the record: its next failure is reported again.
    void succeeded(const std::string& entry, SourceStep step);

private:
    std::mutex mutex_;
    std::map<std::string, std::map<SourceStep, std::string>> reasonsByEntry_;
};

} // namespace Vorn
