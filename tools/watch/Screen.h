// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A terminal in full-screen mode, by ncurses.

#pragma once

#include "tools/output/Table.h"

#include <chrono>
#include <cstddef>
#include <memory>
#include <vector>

namespace Tools {

enum class Key { none, quit, sort, problems, up, down, pageUp, pageDown, top, other };

// Takes over the terminal of standard output until it is destroyed, and discards standard error,
// which would disturb it. At most one may exist. SIGINT and SIGTERM restore the terminal and end
// the process.
class Screen {
public:
    // Sets the locale of the process to that of its environment, which ncurses needs. Throws
    // std::runtime_error when ncurses does not know the terminal.
    explicit Screen(bool isColored);
    ~Screen();
    Screen(const Screen&) = delete;
    Screen& operator=(const Screen&) = delete;

    std::size_t height() const;
    std::size_t width() const;
    bool isUtf8() const;

    // Shows the lines from the first row on and clears the rows below them.
    void show(const std::vector<Line>& lines);

    // Returns the next key; `none` when there is none within that time. After the size has changed,
    // it returns `other`.
    Key waitForKey(std::chrono::milliseconds time);

private:
    struct Terminal;
    std::unique_ptr<Terminal> terminal_;
};

} // namespace Tools
