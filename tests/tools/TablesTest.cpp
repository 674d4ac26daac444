// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The tables of `list` at several widths, on a terminal and in a pipe, with and without UTF-8,
// compared with tests/data/tools/tables.txt. A test that fails writes what it saw to
// tables.txt in the build folder.

#include "tests/tools/ToolTest.h"

#include <gtest/gtest.h>

#include <array>
#include <fstream>

namespace {

using namespace Testing;

const std::string data = SENSOR_PROFILE_SOURCE_DIR "/tests/data/tools/";

std::string onTerminal(unsigned short columns, const std::string& locale)
{
    const Ended ended = runOnTerminal({"list", "--model", data + "tables.json"}, columns,
        {{"TERM", "xterm"}, {"LC_ALL", locale}});
    return replaced(replaced(ended.out, "\r\n", "\n"), "\x1B", "^[");
}

std::string inPipe(unsigned short columns, const std::string& locale)
{
    const Ended ended = run({"list", "--model", data + "tables.json"},
        {.environment = {{"COLUMNS", std::to_string(columns)}, {"LC_ALL", locale}}});
    return ended.out;
}

std::string section(const std::string& title, const std::string& text)
{
    return "== " + title + "\n" + text + "\n";
}

TEST(TablesTest, AreTheGoldenOutput)
{
    std::string seen;
    for (const unsigned short columns : std::array<unsigned short, 4>{60, 80, 120, 200}) {
        const std::string width = std::to_string(columns) + " columns, ";
        seen += section(width + "UTF-8, in a pipe", inPipe(columns, "C.UTF-8"));
        seen += section(width + "UTF-8, on a terminal", onTerminal(columns, "C.UTF-8"));
        seen += section(width + "C or Latin-1, in a pipe", inPipe(columns, "C"));
        seen += section(width + "C or Latin-1, on a terminal", onTerminal(columns, "C"));
        EXPECT_EQ(inPipe(columns, "de_DE.ISO-8859-1"), inPipe(columns, "C"));
        EXPECT_EQ(onTerminal(columns, "de_DE.ISO-8859-1"), onTerminal(columns, "C"));
    }
    EXPECT_EQ(seen, contentOf(data + "tables.txt"));
    if (HasFailure())
        std::ofstream(SENSOR_PROFILE_BINARY_DIR "/tables.txt") << seen;
}

} // namespace
