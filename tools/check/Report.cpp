// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/check/Report.h"

#include "tools/output/PrintableText.h"
#include "tools/output/SensorCells.h"
#include "tools/sensors/Selector.h"

#include <algorithm>
#include <array>
#include <map>
#include <set>

namespace Tools {

namespace {

constexpr std::size_t shownProblems = 8; // in one line

const Range* findRange(const std::vector<Override>& overrides, const Sensor& sensor)
{
    const auto found = std::find_if(overrides.rbegin(), overrides.rend(),
        [&](const Override& each) { return selects(each.selector, sensor); });
    return found == overrides.rend() ? nullptr : &found->range;
}

// Returns the limits as a range; an empty text when there are none. A range without a beginning
// would begin at zero.
std::string rangeText(const std::optional<Quantity>& low, const std::optional<Quantity>& high)
{
    if (!low)
        return high ? "~:" + high->text() : "";
    return low->text() + ":" + (high ? high->text() : "");
}

// Returns the unit of performance data. Revolutions have none.
std::string unitOfMeasurement(const Sensor& sensor)
{
    if (sensor.unit == "RPM")
        return "";
    return printable(sensor.unit, false);
}

// The status of a sensor, and what decided it.
struct Verdict {
    CheckStatus status = CheckStatus::ok;
    const Range* range = nullptr; // null when the sensor's own state decided
};

Verdict verdictOn(const Sensor& sensor, const Range* warning, const Range* critical)
{
    const auto isBeyond = [&](const Range* range) {
        return range != nullptr && sensor.reading && range->raisesAlert(sensor.reading->number());
    };
    if (isBeyond(critical))
        return {CheckStatus::critical, critical};
    const bool hasReading = sensor.reading.has_value();
    if (sensor.state.urgency == Urgency::critical && (critical == nullptr || !hasReading))
        return {CheckStatus::critical};
    if (isBeyond(warning))
        return {CheckStatus::warning, warning};
    if (isProblem(sensor.state.urgency) && (warning == nullptr || !hasReading))
        return {CheckStatus::warning};
    const bool isJudgedByRanges = hasReading && warning != nullptr && critical != nullptr;
    if (sensor.state.urgency == Urgency::unknown && !isJudgedByRanges)
        return {CheckStatus::unknown};
    return {};
}

// A bar begins the performance data; Nagios replaces semicolons.
std::string withoutReserved(std::string text)
{
    std::replace(text.begin(), text.end(), '|', '/');
    std::replace(text.begin(), text.end(), ';', ',');
    return text;
}

std::string performanceName(std::string name)
{
    for (const char reserved : {'\'', '=', '|'})
        std::replace(name.begin(), name.end(), reserved, '_');
    return "'" + printable(name) + "'";
}

// Returns a greater number for a more important status; unknown is less than warning.
int rankOf(CheckStatus status)
{
    constexpr std::array ranks = {0, 2, 3, 1};
    return ranks.at(static_cast<std::size_t>(status));
}

} // namespace

CheckStatus statusOf(const Sensor& sensor, const Overrides& overrides)
{
    return verdictOn(
        sensor, findRange(overrides.warning, sensor), findRange(overrides.critical, sensor))
        .status;
}

void Report::add(CheckStatus status, std::string problem)
{
    problems_.push_back({status, std::move(problem)});
}

void Report::add(const Sensor& sensor, const std::string& name, const Overrides& overrides)
{
    const Range* const warning = findRange(overrides.warning, sensor);
    const Range* const critical = findRange(overrides.critical, sensor);
    const Verdict verdict = verdictOn(sensor, warning, critical);
    const std::string reading = textWithUnit(sensor.reading, sensor);
    if (verdict.range != nullptr)
        add(verdict.status, name + ": " + reading + " is beyond " + verdict.range->text);
    else if (verdict.status != CheckStatus::ok)
        add(verdict.status, name + ": " + std::string(sensor.state.word) +
                                (sensor.reading ? " (" + reading + ")" : ""));
    if (!sensor.reading)
        return;
    const auto& limits = sensor.limits;
    performance_ += " " + performanceName(name) + "=" + sensor.reading->text() +
                    unitOfMeasurement(sensor) + ";" +
                    (warning != nullptr ? warning->text : rangeText(limits[0], limits[3])) + ";" +
                    (critical != nullptr ? critical->text : rangeText(limits[1], limits[4]));
}

CheckStatus Report::status() const
{
    CheckStatus worst = CheckStatus::ok;
    for (const Problem& problem : problems_)
        if (rankOf(problem.status) > rankOf(worst))
            worst = problem.status;
    return worst;
}

std::string Report::toText(const std::string& summary, bool isUtf8) const
{
    constexpr std::array words = {"OK", "WARNING", "CRITICAL", "UNKNOWN"};
    std::vector<Problem> problems = problems_;
    std::stable_sort(
        problems.begin(), problems.end(), [](const Problem& one, const Problem& other) {
            return rankOf(one.status) > rankOf(other.status);
        });
    std::string text;
    for (std::size_t i = 0; i < std::min(problems.size(), shownProblems); ++i)
        text += (text.empty() ? "" : ", ") + problems[i].text;
    if (problems.size() > shownProblems) {
        const std::size_t more = problems.size() - shownProblems;
        text += ", " + std::to_string(more) + (more == 1 ? " more problem" : " more problems");
    }
    if (!summary.empty())
        text += (text.empty() ? "" : " - ") + summary;
    text = withoutReserved(text);
    return std::string("SENSORS ") + words.at(static_cast<std::size_t>(status())) + " - " +
           printable(text, isUtf8) + (performance_.empty() ? "" : " |" + performance_) + "\n";
}

void addSensors(
    Report& report, const Sensors& sensors, const Sensors& machine, const Overrides& overrides)
{
    const auto nameOf = [](const Sensor& sensor) { return sensor.chip + "/" + sensor.label; };
    std::map<std::string, std::size_t> counts;
    for (const Sensor& sensor : machine)
        ++counts[nameOf(sensor)];
    for (const Sensor& sensor : sensors) {
        const std::string name = nameOf(sensor);
        report.add(
            sensor, counts[name] == 1 ? name : name + " (" + sensor.feature + ")", overrides);
    }
}

void addMissing(Report& report, const Sensors& expected, const Sensors& present)
{
    const auto isThere = [](const Sensor& sensor) {
        return sensor.state.word != noContactState.word;
    };
    std::set<std::string> chips;
    std::map<std::string, bool> paths; // and whether the sensors are there
    for (const Sensor& sensor : present) {
        chips.insert(sensor.chip);
        paths[sensor.path] = isThere(sensor);
    }
    std::set<std::string> missingChips;
    for (const Sensor& sensor : expected) {
        const auto found = paths.find(sensor.path);
        if (found != paths.end() && !found->second && isThere(sensor))
            report.add(CheckStatus::critical, sensor.path + " has no contact");
        if (found != paths.end())
            continue;
        if (chips.contains(sensor.chip))
            report.add(CheckStatus::critical, sensor.path + " is missing");
        else if (missingChips.insert(sensor.chip).second)
            report.add(CheckStatus::critical, "chip " + sensor.chip + " is missing");
    }
}

} // namespace Tools
