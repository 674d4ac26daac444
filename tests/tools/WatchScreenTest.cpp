// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Whole screens of `watch` in a real terminal of several sizes, compared with
// tests/data/tools/screens.txt. A test that fails writes what it saw to screens.txt in the build
// folder.

#include "tests/support/Texts.h"
#include "tests/tools/Tmux.h"

#include <gtest/gtest.h>

#include <fstream>
#include <regex>

namespace {

using namespace Testing;

const std::string data = SENSOR_PROFILE_SOURCE_DIR "/tests/data/tools/";

std::string command(const std::string& locale)
{
    return "env -u NO_COLOR LC_ALL=" + locale + " RYNLOG_LOG=off RYNLOG_TRACE=off " + sensorctl +
           " watch --interval 3600 --model " + data + "tables.json";
}

std::string section(const std::string& title, const std::string& screen)
{
    static const std::regex time("[0-9]{2}:[0-9]{2}:[0-9]{2}");
    return "== " + title + "\n" + std::regex_replace(screen, time, "HH:MM:SS") + "\n";
}

TEST(WatchScreenTest, IsTheGoldenOutput)
{
    const Tmux terminal(command("C.UTF-8"), 80, 24);
    std::string seen = section("80 by 24", terminal.waitFor("\nq quit"));
    terminal.press("p");
    seen += section("80 by 24, problems only", terminal.waitFor("problems only\n"));
    terminal.press("p");
    terminal.press("s");
    terminal.resize(120, 40);
    seen += section("120 by 40, by state", terminal.waitForScreen([](const std::string& screen) {
        return linesOf(screen).size() == 40 && screen.find("by state\n") != std::string::npos;
    }));
    const Tmux small(command("C"), 48, 12);
    seen += section("48 by 12, without UTF-8", small.waitFor("\nq quit"));
    EXPECT_EQ(seen, contentOf(data + "screens.txt"));
    if (HasFailure())
        std::ofstream(SENSOR_PROFILE_BINARY_DIR "/screens.txt") << seen;
}

} // namespace
