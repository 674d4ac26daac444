// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/FailureLog.h"

#include "platform/instrumentation/Report.h"

#include <algorithm>

namespace Vorn {

namespace {

// The entries come from the environment and are few. The bound covers a process that changes its
// environment repeatedly.
constexpr std::size_t maximumEntries = 64;

bool isKnown(const std::map<SourceStep, std::string>& reasons, const std::string& reason)
{
    return std::any_of(reasons.begin(), reasons.end(),
        [&](const auto& stepAndReason) { return stepAndReason.second == reason; });
}

} // namespace

FailureLog& FailureLog::instance()
{
    static FailureLog log;
    return log;
}

void FailureLog::failed(const std::string& entry, SourceStep step, const std::string& reason)
{
    const std::lock_guard lock(mutex_);
    if (reasonsByEntry_.size() >= maximumEntries && !reasonsByEntry_.contains(entry))
        reasonsByEntry_.clear();
    auto& reasons = reasonsByEntry_[entry];
    const bool isNew = !isKnown(reasons, reason);
    reasons[step] = reason;
    if (isNew)
        report("FailureLog", "source \"" + entry + "\" cannot be used: " + reason);
}

void FailureLog::succeeded(const std::string& entry, SourceStep step)
{
    const std::lock_guard lock(mutex_);
    const auto found = reasonsByEntry_.find(entry);
    if (found == reasonsByEntry_.end())
        return;
    found->second.erase(step);
    if (found->second.empty())
        reasonsByEntry_.erase(found);
}

} // namespace Vorn
