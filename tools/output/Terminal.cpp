// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/Terminal.h"

#include <sys/ioctl.h>
#include <unistd.h>

#include <algorithm>
#include <cctype>
#include <charconv>
#include <cstdlib>
#include <string>
#include <string_view>

namespace Tools {

namespace {

constexpr std::size_t usualWidth = 80;

// Returns an empty text for a variable that is not set.
std::string_view setting(const char* variable)
{
    const char* const value = std::getenv(variable);
    return value == nullptr ? std::string_view{} : value;
}

// Returns 0 when the variable is no number.
std::size_t wantedWidth()
{
    const std::string_view text = setting("COLUMNS");
    std::size_t width = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), width);
    return error == std::errc{} && end == text.data() + text.size() ? width : 0;
}

} // namespace

std::size_t outputWidth()
{
    if (const std::size_t width = wantedWidth())
        return width;
    if (::isatty(STDOUT_FILENO) == 0)
        return unlimited;
    winsize size{};
    if (::ioctl(STDOUT_FILENO, TIOCGWINSZ, &size) == 0 && size.ws_col != 0)
        return size.ws_col;
    return usualWidth;
}

bool isUtf8Locale()
{
    // The variables are in their order of precedence (POSIX).
    for (const char* const variable : {"LC_ALL", "LC_CTYPE", "LANG"}) {
        std::string locale(setting(variable));
        if (locale.empty())
            continue;
        std::erase(locale, '-');
        std::transform(locale.begin(), locale.end(), locale.begin(),
            [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
        return locale.find(".utf8") != std::string::npos;
    }
    return false;
}

bool isColorTerminal()
{
    return setting("NO_COLOR").empty() && setting("TERM") != "dumb" && !setting("TERM").empty() &&
           ::isatty(STDOUT_FILENO) != 0;
}

} // namespace Tools
