// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The tables of `list` at several widths, on a terminal and in a pipe, with and without UTF-8,
// compared with the files of tests/data/tools/tables/. A test that fails writes what it saw to the
// folder `tables` of the build.

#include "tests/tools/ToolTest.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <filesystem>
#include <fstream>

namespace {

using namespace Testing;

const std::string data = SENSOR_PROFILE_SOURCE_DIR "/tests/data/tools/tables/";

class TablesTest : public testing::Test {
protected:
    std::string onTerminal(const std::string& locale) const
    {
        const Ended ended =
            runOnTerminal(arguments_, columns_, {{"TERM", "xterm"}, {"LC_ALL", locale}});
        return replaced(replaced(ended.out, "\r\n", "\n"), "\x1B", "^[");
    }

    std::string inPipe(const std::string& locale) const
    {
        return run(arguments_,
            {.environment = {{"COLUMNS", std::to_string(columns_)}, {"LC_ALL", locale}}})
            .out;
    }

    std::string sections() const
    {
        EXPECT_EQ(inPipe("de_DE.ISO-8859-1"), inPipe("C"));
        EXPECT_EQ(onTerminal("de_DE.ISO-8859-1"), onTerminal("C"));
        const std::string title = "== " + std::to_string(columns_) + " columns, ";
        return title + "UTF-8, in a pipe\n" + inPipe("C.UTF-8") + "\n" + title +
               "UTF-8, on a terminal\n" + onTerminal("C.UTF-8") + "\n" + title +
               "C or Latin-1, in a pipe\n" + inPipe("C") + "\n" + title +
               "C or Latin-1, on a terminal\n" + onTerminal("C") + "\n";
    }

    void compare(const std::string& file, const std::vector<std::string>& options)
    {
        arguments_ = {"list", "--model", data + "machine.json"};
        arguments_.insert(arguments_.end(), options.begin(), options.end());
        std::string seen;
        for (const unsigned short columns : std::array<unsigned short, 5>{40, 60, 80, 120, 200}) {
            columns_ = columns;
            seen += sections();
        }
        EXPECT_EQ(seen, contentOf(data + file));
        if (!HasFailure())
            return;
        std::filesystem::create_directory(SENSOR_PROFILE_BINARY_DIR "/tables");
        std::ofstream(SENSOR_PROFILE_BINARY_DIR "/tables/" + file) << seen;
    }

    std::vector<std::string> arguments_;
    unsigned short columns_ = 0;
};

TEST_F(TablesTest, ByChipAreTheGoldenOutput)
{
    compare("list.txt", {});
}

TEST_F(TablesTest, FlatAreTheGoldenOutput)
{
    compare("flat.txt", {"--flat"});
}

} // namespace
