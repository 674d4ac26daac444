// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/SensorState.h"

#include <algorithm>
#include <array>

namespace Tools {

namespace {

constexpr unsigned none = 0;

// The values of CurrentState, and the codes of OperationalStatus for which there is none (the value
// maps of CIM_ManagedSystemElement).
struct StateRow {
    std::string_view currentState;
    unsigned operationalStatus;
    SensorState state;
};
constexpr std::array stateRows = {
    StateRow{"Normal", none, {"Normal", Severity::normal}},
    StateRow{"WarningLow", none, {"Warning low", Severity::warning}},
    StateRow{"WarningHigh", none, {"Warning high", Severity::warning}},
    StateRow{"Warning", none, {"Warning", Severity::warning}},
    StateRow{"CriticalLow", none, {"Critical low", Severity::critical}},
    StateRow{"CriticalHigh", none, {"Critical high", Severity::critical}},
    StateRow{"Critical", none, {"Critical", Severity::critical}},
    StateRow{"Disabled", none, {"Disabled", Severity::inactive}},
    StateRow{"Offline", none, {"Offline", Severity::inactive}},
    StateRow{"", 5, {"Failing soon", Severity::warning}},
    StateRow{"", 8, {"Starting", Severity::inactive}},
    StateRow{"", 9, {"Stopping", Severity::inactive}},
    StateRow{"", 10, {"Stopped", Severity::inactive}},
    StateRow{"", 12, {"No contact", Severity::lost}},
    StateRow{"", 13, {"Lost", Severity::lost}},
    StateRow{"", 15, {"Dormant", Severity::inactive}},
};

} // namespace

SensorState stateOf(std::string_view currentState, std::span<const unsigned> statuses)
{
    const bool isKnown = !currentState.empty() && currentState != "Unknown";
    const auto row = std::find_if(stateRows.begin(), stateRows.end(), [&](const StateRow& each) {
        return isKnown ? each.currentState == currentState
                       : each.operationalStatus != none &&
                             std::find(statuses.begin(), statuses.end(), each.operationalStatus) !=
                                 statuses.end();
    });
    return row == stateRows.end() ? SensorState{} : row->state;
}

bool isProblem(Severity severity)
{
    return severity >= Severity::lost;
}

std::string_view wordOf(Severity severity)
{
    constexpr std::array<std::string_view, 6> words = {
        "normal", "inactive", "unknown", "lost", "warning", "critical"};
    return words.at(static_cast<std::size_t>(severity));
}

} // namespace Tools
