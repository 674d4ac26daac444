// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/SensorState.h"

#include <algorithm>
#include <array>

namespace Tools {

namespace {

constexpr unsigned none = 0;

// The values of CurrentState, and the codes of OperationalStatus for which there is none (the value
// maps of CIM_ManagedSystemElement). As their order numbers the states, rows are added at the end.
struct StateRow {
    std::string_view currentState;
    unsigned operationalStatus;
    SensorState state;
};
constexpr std::array stateRows = {
    StateRow{"Normal", none, {"Normal", Urgency::normal}},
    StateRow{"WarningLow", none, {"Warning low", Urgency::warning}},
    StateRow{"WarningHigh", none, {"Warning high", Urgency::warning}},
    StateRow{"Warning", none, {"Warning", Urgency::warning}},
    StateRow{"CriticalLow", none, {"Critical low", Urgency::critical}},
    StateRow{"CriticalHigh", none, {"Critical high", Urgency::critical}},
    StateRow{"Critical", none, {"Critical", Urgency::critical}},
    StateRow{"Disabled", none, {"Disabled", Urgency::inactive}},
    StateRow{"Offline", none, {"Offline", Urgency::inactive}},
    StateRow{"", 5, {"Failing soon", Urgency::warning}},
    StateRow{"", 8, {"Starting", Urgency::inactive}},
    StateRow{"", 9, {"Stopping", Urgency::inactive}},
    StateRow{"", 10, {"Stopped", Urgency::inactive}},
    StateRow{"", 12, noContactState},
    StateRow{"", 13, {"Lost", Urgency::lost}},
    StateRow{"", 15, {"Dormant", Urgency::inactive}},
};
constexpr unsigned numberOfUnknown = 1;
static_assert(stateRows.size() + numberOfUnknown == greatestStateNumber);

} // namespace

unsigned numberOf(const SensorState& state)
{
    const auto row = std::find_if(stateRows.begin(), stateRows.end(),
        [&](const StateRow& each) { return each.state.word == state.word; });
    return row == stateRows.end()
               ? numberOfUnknown
               : static_cast<unsigned>(row - stateRows.begin()) + numberOfUnknown + 1;
}

SensorState stateNumbered(unsigned number)
{
    return number == numberOfUnknown ? SensorState{}
                                     : stateRows.at(number - numberOfUnknown - 1).state;
}

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

std::optional<std::string_view> wordOfState(std::string_view currentState)
{
    const auto row = std::find_if(stateRows.begin(), stateRows.end(), [&](const StateRow& each) {
        return each.currentState == currentState && !currentState.empty();
    });
    if (row != stateRows.end())
        return row->state.word;
    return currentState == "Unknown" ? std::optional(SensorState{}.word) : std::nullopt;
}

bool isProblem(Urgency urgency)
{
    return urgency >= Urgency::lost;
}

std::string_view wordOf(Urgency urgency)
{
    constexpr std::array<std::string_view, 6> words = {
        "normal", "inactive", "unknown", "lost", "warning", "critical"};
    return words.at(static_cast<std::size_t>(urgency));
}

} // namespace Tools
