// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/EmptyMachine.h"
#include "tools/LibraryLog.h"
#include "tools/SourceOptions.h"
#include "tools/cim/ProviderClient.h"
#include "tools/commands/Commands.h"
#include "tools/commands/DisplayOptions.h"
#include "tools/commands/SelectionOptions.h"
#include "tools/output/Output.h"
#include "tools/output/PrintableText.h"
#include "tools/sensors/ChipDevices.h"
#include "tools/sensors/Sources.h"
#include "tools/watch/Screen.h"
#include "tools/watch/WatchView.h"

#include <CLI/CLI.hpp>

#include <unistd.h>

#include <array>
#include <chrono>
#include <cstdlib>
#include <ctime>
#include <limits>
#include <optional>
#include <stdexcept>
#include <thread>

namespace Tools {

namespace {

using Clock = std::chrono::steady_clock;

constexpr double leastInterval = 0.1; // in seconds
constexpr double greatestInterval = 3600;

constexpr const char* watchFooter =
    "Where standard output is no terminal, it prints a line for each change of state.\n"
    "MIN, MAX and the curve of the latest 120 readings begin when the command starts.\n"
    "Where the terminal is narrow, a bar of the curve is the mean of several.";

bool isScreen()
{
    const char* const terminal = std::getenv("TERM");
    return ::isatty(STDOUT_FILENO) != 0 && terminal != nullptr && *terminal != '\0' &&
           terminal != std::string_view("dumb");
}

// Returns the local time with its offset from UTC (ISO 8601).
std::string timeStamp(std::time_t time)
{
    std::tm local{};
    ::localtime_r(&time, &local);
    std::array<char, 32> text{};
    std::strftime(text.data(), text.size(), "%Y-%m-%dT%H:%M:%S%z", &local);
    return text.data();
}

class WatchCommand : public Command {
public:
    explicit WatchCommand(CLI::App& tool)
        : Command(tool, "watch", "Show the sensors and their changes until a key ends it")
    {
        selection_.addTo(parser());
        parser().add_flag(
            "--problems", onlyProblems_, "Begin with problems only; in a pipe: their changes");
        parser()
            .add_option("--interval", interval_, "Seconds between two readings (default: 2)")
            ->type_name("SECONDS")
            ->check(CLI::Range(leastInterval, greatestInterval).description(""));
        display_.addColor(parser());
        source_.addModel(parser());
        source_.addProvider(parser());
        parser().footer(watchFooter);
    }

    void useLog(LibraryLog& log) override { log_ = &log; }

    ExitCode run(Output& out) override
    {
        source_.selectMachine();
        const ExitCode code = watch(out);
        if (code != ExitCode::nothingFound || !isMachineEmpty_)
            return code;
        checkMachineIsEmpty();
        return complainOfEmptyMachine(source_.model());
    }

private:
    ExitCode watch(Output& out)
    {
        std::optional<ProviderClient> provider(std::in_place, source_.sensorProviderFile());
        const Sensors all = readSensors(*provider, false);
        isMachineEmpty_ = all.empty();
        const auto selected = selection_.select(all);
        if (!isMachineEmpty_)
            for (const std::string& complaint : selected.complaints)
                complain(complaint);
        if (isMachineEmpty_ || !selected.complaints.empty())
            return ExitCode::nothingFound;
        if (isScreen())
            return showScreen(provider);
        printChanges(provider, out);
    }

    Sensors readAll(std::optional<ProviderClient>& provider) const
    {
        if (provider)
            provider->beginRequest();
        else
            provider.emplace(source_.sensorProviderFile());
        return readSensors(*provider, false);
    }

    Sensors selected(const Sensors& all) const
    {
        Sensors sensors = selection_.select(all).sensors;
        if (readsHwmon())
            nameDevices(sensors);
        return sensors;
    }

    struct HistoryRenewal {
        std::vector<Change> changes;
        std::string failure; // empty when the sensors could be read
    };

    // Updates the history. While a source fails, the sensors that are absent may be its own, and
    // stay as they were. There is no provider then, and the next call loads it again.
    HistoryRenewal renew(std::optional<ProviderClient>& provider, History& history) const
    {
        try {
            const std::time_t now = std::time(nullptr);
            Sensors all = readAll(provider);
            if (all.empty() || history.isSomeAbsent(selected(all))) {
                provider.reset();
                if (const auto failures = failuresOfSources(false); !failures.empty())
                    return {history.update(selected(all), now, true), failures.front()};
                all = readAll(provider); // the source may have recovered since
            }
            if (all.empty()) {
                provider.reset();
                checkMachineIsEmpty();
            }
            return {history.update(selected(all), now), ""};
        } catch (const std::runtime_error& error) {
            return {{}, error.what()};
        }
    }

    // Returns when a write fails by an exception only.
    [[noreturn]] void printChanges(std::optional<ProviderClient>& provider, Output& out) const
    {
        History history;
        std::string failure;
        for (;; std::this_thread::sleep_for(std::chrono::duration<double>(interval_))) {
            const HistoryRenewal renewal = renew(provider, history);
            for (const Change& change : renewal.changes)
                if (!onlyProblems_ || isProblem(change.urgency) || isProblem(change.urgencyBefore))
                    out.write(timeStamp(change.time) + " " +
                              printable(change.text, display_.style().isUtf8) + "\n");
            out.flush();
            if (!renewal.failure.empty() && renewal.failure != failure)
                complain(renewal.failure);
            failure = renewal.failure;
            log_->printMessages(failure);
        }
    }

    ExitCode showScreen(std::optional<ProviderClient>& provider) const
    {
        const std::chrono::milliseconds interval(static_cast<long>(interval_ * 1000));
        Screen screen(display_.style().isColored);
        History history;
        WatchView view;
        if (onlyProblems_)
            view.toggleProblems();
        Clock::time_point next = Clock::now();
        for (Key key = Key::none; key != Key::quit;) {
            if (Clock::now() >= next) {
                update(view, renew(provider, history));
                next = Clock::now() + interval;
            }
            const TextStyle style = {screen.width(), false, screen.isUtf8()};
            screen.show(view.lines(history, intervalText(), screen.height(), style));
            const auto rest =
                std::chrono::duration_cast<std::chrono::milliseconds>(next - Clock::now());
            key = screen.waitForKey(std::max(rest, std::chrono::milliseconds(0)));
            apply(key, view, static_cast<int>(screen.height()) / 2);
        }
        return ExitCode::success;
    }

    void update(WatchView& view, const HistoryRenewal& renewal) const
    {
        view.add(renewal.changes);
        view.setFailure(renewal.failure);
        for (const std::string& message : log_->takeMessages(renewal.failure))
            view.add({{std::time(nullptr), message, Urgency::warning}});
    }

    static void apply(Key key, WatchView& view, int page)
    {
        switch (key) {
        case Key::sort:
            return view.nextOrder();
        case Key::problems:
            return view.toggleProblems();
        case Key::up:
            return view.scroll(-1);
        case Key::down:
            return view.scroll(1);
        case Key::pageUp:
            return view.scroll(-page);
        case Key::pageDown:
            return view.scroll(page);
        case Key::top:
            return view.scroll(std::numeric_limits<int>::min() / 2);
        case Key::none:
        case Key::quit:
        case Key::other:
            break;
        }
    }

    std::string intervalText() const
    {
        std::string text = std::to_string(interval_);
        text.erase(text.find_last_not_of('0') + 1);
        return text.ends_with('.') ? text.substr(0, text.size() - 1) : text;
    }

    SelectionOptions selection_;
    bool onlyProblems_ = false;
    double interval_ = 2;
    bool isMachineEmpty_ = false;
    DisplayOptions display_;
    SourceOptions source_;
    LibraryLog* log_ = nullptr;
};

} // namespace

std::unique_ptr<Command> makeWatchCommand(CLI::App& tool)
{
    return std::make_unique<WatchCommand>(tool);
}

} // namespace Tools
