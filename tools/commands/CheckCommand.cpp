// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/EmptyMachine.h"
#include "tools/SourceOptions.h"
#include "tools/UsageError.h"
#include "tools/check/Report.h"
#include "tools/cim/ProviderClient.h"
#include "tools/commands/Commands.h"
#include "tools/commands/SelectionOptions.h"
#include "tools/output/Output.h"
#include "tools/output/Terminal.h"
#include "tools/sensors/Selector.h"
#include "tools/sensors/Sources.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <stdexcept>

namespace Tools {

namespace {

constexpr const char* checkFooter =
    "Prints one line with performance data as monitoring plugins do, and exits with\n"
    "0 OK, 1 WARNING, 2 CRITICAL, 3 UNKNOWN. A lost sensor is a WARNING, one that is\n"
    "missing from FILE's machine CRITICAL. RANGE is that of plugins: 80, 10:80, 10:,\n"
    "~:80 or @10:80. It replaces a sensor's own limits of that kind only: to\n"
    "silence a sensor, give both options.";

std::vector<Override> overridesIn(const std::vector<std::string>& texts)
{
    std::vector<Override> overrides;
    for (const std::string& text : texts) {
        const auto end = text.rfind('=');
        if (end == std::string::npos)
            throw UsageError("\"" + text + "\" is not SELECTOR=RANGE");
        try {
            overrides.push_back({text.substr(0, end), readRange(text.substr(end + 1))});
        } catch (const std::invalid_argument& error) {
            throw UsageError(error.what());
        }
    }
    return overrides;
}

// Returns a sentence about the sensors that are left of those that were judged; an empty text where
// there were none.
std::string summaryOfJudged(const Sensors& sensors, std::size_t judged)
{
    if (!sensors.empty())
        return summaryOf(sensors);
    return judged == 0 ? ""
                       : "no problem in " + std::to_string(judged) +
                             (judged == 1 ? " sensor." : " sensors.");
}

class CheckCommand : public Command {
public:
    explicit CheckCommand(CLI::App& tool)
        : Command(tool, "check", "Judge the sensors for a monitoring system")
    {
        selection_.addTo(parser());
        parser().add_flag("--problems", onlyProblems_, "Leave out the sensors that are OK");
        parser()
            .add_option("--warning", warning_, "WARNING where a reading is beyond the range")
            ->type_name("SELECTOR=RANGE")
            ->allow_extra_args(false);
        parser()
            .add_option("--critical", critical_, "CRITICAL where a reading is beyond the range")
            ->type_name("SELECTOR=RANGE")
            ->allow_extra_args(false);
        parser()
            .add_option("--expect", expected_, "All of this recorded machine has to be there")
            ->type_name("FILE");
        source_.addModel(parser());
        source_.addProvider(parser());
        parser().footer(checkFooter);
    }

    ExitCode run(Output& out) override
    {
        const Overrides overrides = {overridesIn(warning_), overridesIn(critical_)};
        const Sensors expected = expectedSensors();
        source_.selectMachine();
        const Sensors all = readMachine();
        if (all.empty())
            checkMachineIsEmpty();

        Report report;
        auto selected = selection_.select(all);
        const std::size_t judged = selected.sensors.size();
        if (onlyProblems_)
            std::erase_if(selected.sensors, [&](const Sensor& sensor) {
                return statusOf(sensor, overrides) == CheckStatus::ok;
            });
        addMissing(report, expected, all);
        addSensors(report, selected.sensors, all, overrides);
        for (const auto* const list : {&overrides.warning, &overrides.critical})
            for (const Override& each : *list)
                if (std::none_of(all.begin(), all.end(),
                        [&](const Sensor& sensor) { return selects(each.selector, sensor); }))
                    report.add(CheckStatus::unknown, nothingMatches(each.selector, all));
        const bool areChipsListed = std::any_of(all.begin(), all.end(),
            [](const Sensor& sensor) { return sensor.path.starts_with("/hwmon/"); });
        for (const std::string& reason : failuresOfSources(areChipsListed))
            report.add(CheckStatus::unknown, reason);
        if (all.empty())
            report.add(CheckStatus::unknown, "this machine has no sensors");
        else
            for (const std::string& complaint : selected.complaints)
                report.add(CheckStatus::unknown, complaint);
        out.write(report.toText(summaryOfJudged(selected.sensors, judged), isUtf8Locale()));
        return static_cast<ExitCode>(report.status());
    }

    // Monitoring systems read standard output, and take exit code 2 for a critical state.
    ExitCode reportFailure(Output& out, const std::string& reason, ExitCode /*code*/) const override
    {
        try {
            Report report;
            report.add(CheckStatus::unknown, reason);
            out.write(report.toText("", isUtf8Locale()));
            out.flush();
        } catch (const std::runtime_error& error) {
            complain(error.what());
        }
        return static_cast<ExitCode>(CheckStatus::unknown);
    }

private:
    Sensors expectedSensors() const
    {
        Sensors expected;
        if (expected_)
            expected = sensorsInFile(*expected_);
        std::erase_if(
            expected, [&](const Sensor& sensor) { return !selection_.isSelected(sensor); });
        return expected;
    }

    // Unloads the provider again.
    Sensors readMachine() const
    {
        ProviderClient provider(source_.sensorProviderFile());
        return readSensors(provider, false);
    }

    SelectionOptions selection_;
    bool onlyProblems_ = false;
    std::vector<std::string> warning_;
    std::vector<std::string> critical_;
    std::optional<std::string> expected_;
    SourceOptions source_;
};

} // namespace

std::unique_ptr<Command> makeCheckCommand(CLI::App& tool)
{
    return std::make_unique<CheckCommand>(tool);
}

} // namespace Tools
