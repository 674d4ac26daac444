// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// `watch` in a real terminal, and without one.

#include "tests/support/Pattern.h"
#include "tests/tools/Tmux.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <csignal>

namespace {

using testing::AllOf;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;
using namespace Testing;

class WatchTest : public ToolTest {
protected:
    // Writes the model file that is watched as a whole: it is read while it changes.
    void change(const std::string& nodes) const
    {
        const std::string next = folder_.write("next.json", "{ \"nodes\": [" + nodes + "] }");
        std::filesystem::rename(next, watched_);
    }

    static std::string node(int reading, int status)
    {
        return R"({ "type": "temperature", "path": "/cpu/temp1", "description": "CPU 1",
            "baseUnits": 2, "upperNonCritical": 80, "status": )" +
               std::to_string(status) + R"(, "reading": )" + std::to_string(reading) + "}";
    }

    static std::string fan()
    {
        return R"(, { "type": "tachometer", "path": "/board/fan1", "description": "Lüfter",
            "baseUnits": 19, "status": 1, "reading": 900 })";
    }

    std::string command(const std::string& locale = "C.UTF-8", const std::string& more = "") const
    {
        return "env -u NO_COLOR LC_ALL=" + locale + " RYNLOG_LOG=off RYNLOG_TRACE=off " +
               sensorctl + " watch --interval 0.1 " + more + " --model " + watched_;
    }

    const std::string watched_ = (folder_.path() / "watched.json").string();
};

TEST_F(WatchTest, ShowsTheTableLive)
{
    change(node(41, 1) + fan());
    const Tmux terminal(command(), 80, 24);
    const std::string first = terminal.waitFor("Lüfter");
    EXPECT_THAT(first, StartsWith("sensorctl watch  "));
    EXPECT_THAT(first, AllOf(HasSubstr("every 0.1 s  by chip\n2 sensors: 2 normal.\n"),
                           HasSubstr("\nboard\n  Lüfter"), HasSubstr("\ncpu\n  CPU 1"),
                           HasSubstr("\nq quit  s sort  p problems only")));
    change(node(85, 23) + fan());
    const Pattern row("  CPU 1 +85 °C   Warning high +41 +85  ▁.*█\n");
    const std::string warned =
        terminal.waitForScreen([&](const auto& seen) { return row.isIn(seen); });
    EXPECT_THAT(warned, HasSubstr("2 sensors: 1 normal, 1 warning.\n"));
    EXPECT_TRUE(row.isIn(warned)) << warned;
    const Pattern event("\n[0-9:]{8} cpu/CPU 1: Normal -> Warning high \\(85 °C\\)\n");
    EXPECT_TRUE(event.isIn(warned)) << warned;
    EXPECT_THAT(terminal.screen(true), HasSubstr("\x1B[33mWarning high"));
}

TEST_F(WatchTest, SensorThatVanishesIsMissingUntilItComesBack)
{
    change(node(41, 1) + fan());
    const Tmux terminal(command(), 80, 24);
    terminal.waitFor("Lüfter");
    change(node(41, 1));
    const std::string gone = terminal.waitFor("board/Lüfter: Normal -> Missing");
    EXPECT_TRUE(Pattern("  Lüfter +- +Missing +900  900").isIn(gone)) << gone;
    change(node(41, 1) + fan());
    EXPECT_THAT(terminal.waitFor("Missing -> Normal"), HasSubstr("2 sensors: 2 normal.\n"));
}

TEST_F(WatchTest, KeysFilterSortScrollAndQuit)
{
    std::string nodes = node(85, 23);
    for (int i = 1; i <= 40; ++i)
        nodes += R"(, { "type": "voltage", "status": 1, "reading": 1, "path": "/a/in)" +
                 std::to_string(i) + R"(", "description": "in)" + std::to_string(i) + "\" }";
    change(nodes);
    const Tmux terminal(command(), 80, 24);
    EXPECT_THAT(terminal.waitFor("in1 "), Not(HasSubstr("CPU 1")));
    terminal.press("NPage");
    EXPECT_THAT(terminal.waitFor("in25 "), Not(HasSubstr("  in1 ")));
    terminal.press("Home");
    terminal.waitFor("  in1 ");
    terminal.press("p");
    EXPECT_THAT(terminal.waitFor("by chip, problems only"),
        AllOf(HasSubstr("CPU 1"), Not(HasSubstr("in1 "))));
    terminal.press("p");
    terminal.press("s");
    EXPECT_THAT(terminal.waitFor("by state\n"), HasSubstr("\nCPU 1 (cpu)"));
    terminal.press("s");
    EXPECT_THAT(terminal.waitFor("by name\n"), HasSubstr("\nCPU 1 (cpu)"));
    terminal.press("q");
    EXPECT_THAT(terminal.waitFor("ended with"), StartsWith("ended with 0\n"));
}

TEST_F(WatchTest, BeginsWithTheProblemsOfTheKindOnRequest)
{
    change(node(85, 23) + fan());
    const Tmux problems(command("C.UTF-8", "--problems"), 80, 24);
    EXPECT_THAT(problems.waitFor("q quit"),
        AllOf(HasSubstr("by chip, problems only\n"), HasSubstr("CPU 1"), Not(HasSubstr("Lüfter"))));
    problems.press("p");
    problems.waitFor("Lüfter");
    const Tmux fans(command("C.UTF-8", "--kind fan"), 80, 24);
    EXPECT_THAT(fans.waitFor("q quit"), AllOf(HasSubstr("Lüfter"), Not(HasSubstr("CPU 1"))));
}

TEST_F(WatchTest, SurvivesResizing)
{
    change(node(41, 1) + fan());
    const Tmux terminal(command(), 80, 24);
    terminal.waitFor("MIN");
    terminal.resize(44, 8);
    const std::string small = terminal.waitForScreen([](const std::string& seen) {
        return seen.starts_with("sensorctl watch") && seen.find("MIN") == std::string::npos &&
               seen.find("\nq quit") != std::string::npos;
    });
    EXPECT_THAT(small, AllOf(HasSubstr("q quit  s sort"), HasSubstr("41 °C   Normal")));
    EXPECT_EQ(linesOf(small).size(), 8U) << small;
    terminal.resize(5, 2);
    terminal.waitFor("sens…");
    terminal.resize(80, 24);
    terminal.waitFor("MIN");
}

TEST_F(WatchTest, SignalRestoresTheTerminal)
{
    change(node(41, 1));
    const Tmux terminal(
        "sh -c 'echo $$ >" + folder_.path().string() + "/pid; exec " + command() + "'", 80, 24);
    terminal.waitFor("CPU 1");
    const int process = std::stoi(contentOf(folder_.path() / "pid"));
    ::kill(process, SIGTERM);
    EXPECT_THAT(terminal.waitFor("ended with"), Not(HasSubstr("CPU 1")));
}

TEST_F(WatchTest, WithoutUtf8ItIsAscii)
{
    change(node(41, 1) + fan());
    const Tmux terminal(command("C"), 80, 24);
    const std::string seen = terminal.waitFor("41 C ");
    EXPECT_THAT(seen, AllOf(HasSubstr("L\\u00FCfter"), HasSubstr("41 C ")));
    EXPECT_TRUE(std::all_of(seen.begin(), seen.end(), [](char c) { return c > 0; })) << seen;
}

TEST_F(WatchTest, WithoutATerminalPrintsEachChange)
{
    change(node(41, 1));
    folder_.write("a", contentOf(watched_));
    folder_.write("b", "{ \"nodes\": [" + node(85, 23) + "] }");
    const std::string script = "cd " + folder_.path().string() + "; " + command("C") +
                               " >out & while [ ! -s out ]; do for each in b a; do cp $each next; "
                               "mv next watched.json; sleep 0.4; done; done; kill $!; cat out";
    const Ended ended = run({"-c", script}, {.program = "/bin/sh"});
    const auto lines = linesOf(ended.out);
    ASSERT_GE(lines.size(), 1U);
    const Pattern form("[0-9]{4}-[0-9]{2}-[0-9]{2}T[0-9:]{8}[-+][0-9]{4} cpu/CPU 1: (Normal -> "
                       "Warning high \\(85 C\\)|Warning high -> Normal \\(41 C\\))");
    for (const std::string& line : lines)
        EXPECT_TRUE(form.matches(line)) << line;
}

TEST_F(WatchTest, SourceThatFailsIsTheReasonOnTheScreen)
{
    change(node(41, 1) + fan());
    const Tmux terminal(command(), 80, 24);
    terminal.waitFor("2 sensors: 2 normal.");
    change("nothing of a model");
    const std::string failed = terminal.waitFor("model file");
    EXPECT_THAT(failed, AllOf(HasSubstr("41 °C"), Not(HasSubstr("Missing"))));
    change(node(42, 1) + fan());
    EXPECT_THAT(terminal.waitFor("2 sensors: 2 normal."), Not(HasSubstr("Missing")));
}

TEST_F(WatchTest, SourceThatFailsIsTheReasonInAPipe)
{
    change(node(41, 1));
    folder_.write("torn", "{");
    folder_.write("warning", "{ \"nodes\": [" + node(85, 23) + "] }");
    const std::string script =
        "cd " + folder_.path().string() + "; " + sensorctl +
        " watch --interval 0.1 --model watched.json >out 2>err & sleep 1; mv torn watched.json; "
        "while [ ! -s err ]; do sleep 0.1; done; sleep 0.5; mv warning watched.json; "
        "while [ ! -s out ]; do sleep 0.1; done; kill $!; cat out; cat err >&2";
    const Ended ended =
        run({"-c", script}, {.program = "/bin/sh", .environment = {{"RYNLOG_LOG", ""}}});
    EXPECT_EQ(linesOf(ended.out).size(), 1U) << ended.out;
    EXPECT_THAT(ended.out, HasSubstr(" cpu/CPU 1: Normal -> Warning high"));
    EXPECT_EQ(linesOf(ended.err).size(), 1U) << ended.err;
    EXPECT_THAT(ended.err, StartsWith("sensorctl: model file "));
}

TEST_F(WatchTest, SourceThatFailsLeavesItsSensorsAndThoseOfOthers)
{
    change(node(41, 1));
    folder_.write("torn", "{");
    folder_.write("warning", "{ \"nodes\": [" + node(85, 23) + "] }");
    const std::string running = "{ \"nodes\": [" + fan().substr(1) + "] }";
    folder_.write("running", running);
    folder_.write("other.json", running);
    folder_.write("lost", replaced(running, "\"status\": 1", "\"status\": 13"));
    folder_.write("critical", replaced(running, "\"status\": 1", "\"status\": 26"));
    const std::string script =
        "cd " + folder_.path().string() + "; export VORN_INSTRUMENTATION=model:" + watched_ +
        ",model:$PWD/other.json; " + sensorctl +
        " watch --interval 0.1 >out 2>>err & "
        "put() { cp $1 next; mv next $2; }; "
        "waitFor() { for i in $(seq 100); do ! grep -q \"$1\" $2 || return 0; sleep 0.1; done; }; "
        "for i in $(seq 50); do for each in lost running; do "
        "[ -s out ] || { put $each other.json; sleep 0.2; }; done; done; "
        "put torn watched.json; waitFor model err; cp err first; : >err; "
        "put critical other.json; waitFor Critical out; "
        "put warning watched.json; waitFor Warning out; "
        "put torn watched.json; waitFor model err; kill $!; cat out; cat first err >&2";
    const Ended ended =
        run({"-c", script}, {.program = "/bin/sh", .environment = {{"RYNLOG_LOG", ""}}});
    EXPECT_THAT(ended.out,
        AllOf(HasSubstr(" -> Critical"), HasSubstr(" -> Warning high"), Not(HasSubstr("Missing"))));
    const auto reasons = linesOf(ended.err);
    ASSERT_EQ(reasons.size(), 2U) << ended.err;
    EXPECT_THAT(reasons[0], StartsWith("sensorctl: model file " + watched_ + ":"));
    EXPECT_EQ(reasons[1], reasons[0]);
}

TEST_F(WatchTest, ProblemsOfAPipeAreChangesFromOrToOne)
{
    const auto withAnother = [](const std::string& first, int status) {
        const std::string other = replaced(node(41, status), "CPU 1", "CPU 2");
        return first + ", " + replaced(other, "/cpu/", "/other/");
    };
    change(withAnother(node(41, 1), 1));
    folder_.write("first", contentOf(watched_));
    folder_.write("changed", "{ \"nodes\": [" + withAnother(node(85, 23), 0) + "] }");
    const std::string script =
        "cd " + folder_.path().string() + "; " + command("C", "--problems") +
        " >out & for i in $(seq 25); do for each in changed first; do "
        "[ $(wc -l <out) -ge 2 ] || { cp $each next; mv next watched.json; sleep 0.4; }; "
        "done; done; kill $!; cat out";
    const auto lines = linesOf(run({"-c", script}, {.program = "/bin/sh"}).out);
    EXPECT_GE(lines.size(), 2U);
    for (const std::string& line : lines)
        EXPECT_THAT(line, HasSubstr(" cpu/CPU 1: "));
}

TEST_F(WatchTest, WhatNothingMatchesIsSaidBeforeTheScreenIsTaken)
{
    change(node(41, 1));
    const Tmux terminal(command("C.UTF-8", "CPU2"), 80, 24);
    EXPECT_THAT(terminal.waitFor("ended with 3"), HasSubstr("no sensor matches \"CPU2\""));
    change("");
    EXPECT_EQ(run({"watch", "--model", watched_}).err,
        "sensorctl: " + watched_ + ": this machine has no sensors\n");
}

TEST_F(WatchTest, UnknownTerminalIsAFailure)
{
    change(node(41, 1));
    const Ended ended = runOnTerminal({"watch", "--model", watched_}, 80, {{"TERM", "abacus"}});
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.out, HasSubstr("sensorctl: unknown terminal"));
}

} // namespace
