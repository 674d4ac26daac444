// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/watch/Screen.h"

#include <curses.h>
#include <fcntl.h>
#include <langinfo.h>
#include <unistd.h>

#include <algorithm>
#include <clocale>
#include <cstdio>
#include <stdexcept>
#include <string_view>
#include <thread>

namespace Tools {

namespace {

// Numbers of ncurses' color pairs.
constexpr short goodPair = 1;
constexpr short warningPair = 2;
constexpr short criticalPair = 3;

attr_t attributesOf(Emphasis emphasis, bool isColored)
{
    const auto pair = [&](short number) {
        return isColored ? static_cast<attr_t>(COLOR_PAIR(number)) : A_NORMAL;
    };
    switch (emphasis) {
    case Emphasis::heading:
        return A_BOLD;
    case Emphasis::faint:
        return A_DIM;
    case Emphasis::good:
        return pair(goodPair);
    case Emphasis::warning:
        return pair(warningPair);
    case Emphasis::critical:
        return pair(criticalPair) | A_BOLD;
    case Emphasis::none:
        break;
    }
    return A_NORMAL;
}

Key keyOf(int code)
{
    switch (code) {
    case ERR:
        return Key::none;
    case 'q':
    case 'Q':
        return Key::quit;
    case 's':
    case 'S':
        return Key::sort;
    case 'p':
    case 'P':
        return Key::problems;
    case KEY_UP:
        return Key::up;
    case KEY_DOWN:
        return Key::down;
    case KEY_PPAGE:
        return Key::pageUp;
    case KEY_NPAGE:
        return Key::pageDown;
    case KEY_HOME:
        return Key::top;
    default:
        return Key::other;
    }
}

} // namespace

struct Screen::Terminal {
    explicit Terminal(bool wantsColors)
        : savedError(::fcntl(STDERR_FILENO, F_DUPFD_CLOEXEC, 0)),
          screen(::newterm(nullptr, stdout, stdin))
    {
        if (screen == nullptr) {
            ::close(savedError);
            throw std::runtime_error("unknown terminal; the variable TERM names it");
        }
        const int nothing = ::open("/dev/null", O_WRONLY | O_CLOEXEC);
        ::dup2(nothing, STDERR_FILENO);
        ::close(nothing);
        ::cbreak();
        ::noecho();
        ::curs_set(0);
        ::keypad(stdscr, true);
        isColored = wantsColors && ::has_colors() && ::start_color() == OK;
        if (!isColored)
            return;
        ::use_default_colors();
        ::init_pair(goodPair, COLOR_GREEN, -1);
        ::init_pair(warningPair, COLOR_YELLOW, -1);
        ::init_pair(criticalPair, COLOR_RED, -1);
    }
    ~Terminal()
    {
        ::endwin();
        ::delscreen(screen);
        ::dup2(savedError, STDERR_FILENO);
        ::close(savedError);
    }
    Terminal(const Terminal&) = delete;
    Terminal& operator=(const Terminal&) = delete;

    int savedError;
    SCREEN* screen;
    bool isColored = false;
};

Screen::Screen(bool isColored)
{
    std::setlocale(LC_ALL, "");
    terminal_ = std::make_unique<Terminal>(isColored);
}

Screen::~Screen() = default;

std::size_t Screen::height() const
{
    return static_cast<std::size_t>(std::max(getmaxy(stdscr), 1));
}

std::size_t Screen::width() const
{
    return static_cast<std::size_t>(std::max(getmaxx(stdscr), 1));
}

bool Screen::isUtf8() const
{
    return std::string_view(::nl_langinfo(CODESET)) == "UTF-8";
}

void Screen::show(const std::vector<Line>& lines)
{
    ::erase();
    for (std::size_t row = 0; row < std::min(lines.size(), height()); ++row) {
        ::move(static_cast<int>(row), 0);
        for (const Cell& cell : cutLine(lines[row], {width(), false, isUtf8()})) {
            ::attrset(static_cast<int>(attributesOf(cell.emphasis, terminal_->isColored)));
            ::addstr(cell.text.c_str());
        }
    }
    ::refresh();
}

Key Screen::waitForKey(std::chrono::milliseconds time)
{
    const auto end = std::chrono::steady_clock::now() + time;
    ::timeout(static_cast<int>(time.count()));
    const Key key = keyOf(::getch());
    if (key == Key::none)
        std::this_thread::sleep_until(end); // standard input may have ended
    return key;
}

} // namespace Tools
