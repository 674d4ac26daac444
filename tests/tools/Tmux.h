// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A program in a real terminal, which tmux emulates.

#pragma once

#include "tests/support/TemporaryFolder.h"
#include "tests/support/WaitUntil.h"
#include "tests/tools/ChildProcess.h"

#include <chrono>
#include <functional>
#include <string>
#include <thread>
#include <vector>

namespace Testing {

class Tmux {
public:
    // Starts the command, for a shell, in a terminal of that size. When it has ended, the terminal
    // shows "ended with" and its exit code.
    Tmux(const std::string& command, int columns, int rows)
    {
        call({"-f", "/dev/null", "-u", "new-session", "-d", "-x", std::to_string(columns), "-y",
            std::to_string(rows), command + "; echo ended with $?; exec sleep 1000"});
    }
    ~Tmux() { call({"kill-server"}); }
    Tmux(const Tmux&) = delete;
    Tmux& operator=(const Tmux&) = delete;

    void press(const std::string& key) const { call({"send-keys", key}); }
    void resize(int columns, int rows) const
    {
        call({"resize-window", "-x", std::to_string(columns), "-y", std::to_string(rows)});
    }

    // Returns the visible lines without the blanks at their ends; with the attributes of characters
    // as control sequences if wanted.
    std::string screen(bool hasAttributes = false) const
    {
        std::vector<std::string> arguments = {"capture-pane", "-p"};
        if (hasAttributes)
            arguments.emplace_back("-e");
        return call(arguments);
    }

    // Waits until the screen has the text. Returns the screen.
    std::string waitFor(const std::string& text) const
    {
        return waitForScreen(
            [&](const std::string& seen) { return seen.find(text) != std::string::npos; });
    }

    // Waits until the condition holds for the screen. Returns the screen.
    std::string waitForScreen(const std::function<bool(const std::string&)>& condition) const
    {
        std::string seen;
        waitUntil([&] {
            seen = screen();
            return condition(seen) && isComplete(seen);
        });
        return seen;
    }

private:
    // A frame that is being drawn differs from the next look at the terminal.
    bool isComplete(const std::string& seen) const
    {
        std::this_thread::sleep_for(std::chrono::milliseconds(50));
        return screen() == seen;
    }

    std::string call(std::vector<std::string> arguments) const
    {
        arguments.insert(arguments.begin(), {"-S", (folder_.path() / "socket").string()});
        return run(arguments,
            {.program = "/usr/bin/tmux", .environment = {{"LC_ALL", "C.UTF-8"}, {"TERM", "xterm"}}})
            .out;
    }

    TemporaryFolder folder_;
};

} // namespace Testing
