// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/tools/ToolTest.h"
#include "tools/output/PrintableText.h"

#include <gmock/gmock.h>

#include <algorithm>

namespace {

using testing::HasSubstr;
using testing::Not;
using namespace Testing;

class TerminalTest : public ToolTest {
protected:
    std::vector<std::string> list(const std::vector<std::string>& more = {}) const
    {
        std::vector<std::string> arguments = {"list", "--model", smallModel()};
        arguments.insert(arguments.end(), more.begin(), more.end());
        return arguments;
    }

    // Returns the width of the longest line, without the carriage returns of the terminal.
    static std::size_t widest(const std::string& output)
    {
        std::size_t width = 0;
        for (std::string line : linesOf(output)) {
            std::erase(line, '\r');
            width = std::max(width, Tools::displayWidth(line));
        }
        return width;
    }
};

TEST_F(TerminalTest, IsColored)
{
    const Ended ended = runOnTerminal(list(), 80);
    EXPECT_EQ(ended.code, 0);
    EXPECT_THAT(ended.out, HasSubstr("\x1B[1;31mCritical high\x1B[0m"));
}

TEST_F(TerminalTest, IsNotColoredWhenTheUserSaysSo)
{
    EXPECT_THAT(runOnTerminal(list({"--color", "never"}), 80).out, Not(HasSubstr("\x1B[")));
    EXPECT_THAT(runOnTerminal(list(), 80, {{"TERM", "xterm"}, {"NO_COLOR", "1"}}).out,
        Not(HasSubstr("\x1B[")));
    EXPECT_THAT(runOnTerminal(list(), 80, {{"TERM", "dumb"}}).out, Not(HasSubstr("\x1B[")));
    EXPECT_THAT(runOnTerminal(list(), 80, {}).out, Not(HasSubstr("\x1B[")));
}

TEST_F(TerminalTest, EmptyNoColorSettingCountsAsUnset)
{
    EXPECT_THAT(
        runOnTerminal(list(), 80, {{"TERM", "xterm"}, {"NO_COLOR", ""}}).out, HasSubstr("\x1B["));
}

TEST_F(TerminalTest, LinesFitItsWidth)
{
    const std::string name =
        "温度センサー温度センサー温度センサー温度センサー温度センサー温度センサー";
    const std::string file = model(R"({ "type": "voltage", "path": "/a", "status": 26,
        "reading": 12.345, "baseUnits": 5, "lowerCritical": 11.4, "upperNonCritical": 12.6,
        "upperCritical": 13.2, "description": ")" +
                                   name + "\" }");
    const auto shown = [&](unsigned short columns) {
        return runOnTerminal({"list", "--color", "never", "--model", file}, columns,
            {{"TERM", "xterm"}, {"LC_ALL", "C.UTF-8"}})
            .out;
    };
    EXPECT_THAT(shown(80), HasSubstr("…"));
    EXPECT_LE(widest(shown(80)), 80U);
    EXPECT_GE(widest(shown(80)), 79U); // a wide character may leave one column free
    EXPECT_LE(widest(shown(100)), 100U);
    EXPECT_THAT(shown(200), HasSubstr(name));
    EXPECT_LE(widest(shown(0)), 80U); // a terminal that reports no width
}

TEST_F(TerminalTest, ColumnsSettingGoesBeforeItsWidth)
{
    const std::string file = model(R"({ "type": "voltage", "path": "/a", "status": 1,
        "description": ")" + std::string(300, 'n') +
                                   "\" }");
    const Ended ended = runOnTerminal({"list", "--model", file}, 80, {{"COLUMNS", "120"}});
    EXPECT_EQ(widest(ended.out), 120U);
    const Ended nonsense = runOnTerminal({"list", "--model", file}, 70, {{"COLUMNS", "wide"}});
    EXPECT_EQ(widest(nonsense.out), 70U);
}

} // namespace
