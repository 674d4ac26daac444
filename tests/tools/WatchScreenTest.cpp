// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Whole screens of `watch` in a real terminal of several sizes, compared with
// tests/data/tools/screens.txt. A test that fails writes what it saw to screens.txt in the build
// folder.

#include "tests/support/Pattern.h"
#include "tests/support/Texts.h"
#include "tests/tools/Tmux.h"

#include <gtest/gtest.h>

#include <fstream>

namespace {

using namespace Testing;

const std::string screenData = SENSOR_PROFILE_SOURCE_DIR "/tests/data/tools/";

std::string command(const std::string& locale)
{
    return "env -u NO_COLOR LC_ALL=" + locale + " RYNLOG_LOG=off RYNLOG_TRACE=off " + sensorctl +
           " watch --interval 3600 --model " + screenData + "tables/machine.json";
}

// Collects the screens that a terminal shows.
class Screens {
public:
    // Waits until the terminal shows the golden screen with that title.
    void add(const std::string& title, const Tmux& terminal)
    {
        static const Pattern time("[0-9]{2}:[0-9]{2}:[0-9]{2}");
        const std::string start = "== " + title + "\n";
        std::string section;
        terminal.waitForScreen([&](const std::string& screen) {
            section = start + time.replace(screen, "HH:MM:SS") + "\n";
            return golden_.find(section) != std::string::npos;
        });
        seen_ += section;
    }

    const std::string& golden() const { return golden_; }
    const std::string& seen() const { return seen_; }

private:
    std::string golden_ = contentOf(screenData + "screens.txt");
    std::string seen_;
};

TEST(WatchScreenTest, IsTheGoldenOutput)
{
    Screens screens;
    const Tmux terminal(command("C.UTF-8"), 80, 24);
    screens.add("80 by 24", terminal);
    terminal.press("p");
    screens.add("80 by 24, problems only", terminal);
    terminal.press("p");
    terminal.press("s");
    terminal.resize(120, 40);
    screens.add("120 by 40, by state", terminal);
    const Tmux small(command("C"), 48, 12);
    screens.add("48 by 12, without UTF-8", small);
    EXPECT_EQ(screens.seen(), screens.golden());
    if (HasFailure())
        std::ofstream(SENSOR_PROFILE_BINARY_DIR "/screens.txt") << screens.seen();
}

} // namespace
