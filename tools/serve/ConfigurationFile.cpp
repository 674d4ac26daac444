// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/ConfigurationFile.h"

#include "platform/text/Trim.h"
#include "tools/UsageError.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <array>
#include <cerrno>
#include <fstream>
#include <optional>
#include <set>
#include <stdexcept>
#include <string_view>
#include <system_error>

namespace Tools {

namespace {

using Text::trimmed;

// These options exist on the command line only.
constexpr std::array<std::string_view, 3> optionsOfCommandLine{"check", "config", "help"};

class Reader {
public:
    explicit Reader(CLI::App& parser) : parser_(parser) {}

    // Throws UsageError with the reason.
    void take(std::string_view line)
    {
        const std::size_t equals = line.find('=');
        if (equals == std::string_view::npos)
            throw UsageError("it is no `name = value`");
        const std::string name(trimmed(line.substr(0, equals)));
        const std::string value(trimmed(line.substr(equals + 1)));
        CLI::Option& option = find(name);
        if (value.empty())
            throw UsageError(name + " has no value");
        const bool isFirst = !seen_.contains(&option);
        if (isFirst)
            seen_.emplace(&option, option.count() > 0);
        else if (option.get_multi_option_policy() != CLI::MultiOptionPolicy::TakeAll)
            throw UsageError("a second line for " + name);
        if (!seen_.at(&option))
            set(option, value, isFirst);
    }

private:
    CLI::Option& find(const std::string& name)
    {
        const auto* const end = optionsOfCommandLine.end();
        CLI::Option* const option = std::find(optionsOfCommandLine.begin(), end, name) != end
                                        ? nullptr
                                        : parser_.get_option_no_throw("--" + name);
        if (option == nullptr)
            throw UsageError("there is no setting \"" + name + "\"");
        return *option;
    }

    static void set(CLI::Option& option, const std::string& value, bool isFirst)
    {
        try {
            if (isFirst)
                option.clear();
            option.add_result(value);
            option.run_callback();
        } catch (const CLI::ParseError& error) {
            throw UsageError(error.what());
        }
    }

    CLI::App& parser_;
    std::map<const CLI::Option*, bool> seen_; // whether the command line set it
};

} // namespace

void applyConfigurationFile(CLI::App& parser, const std::string& file)
{
    std::ifstream in(file);
    if (!in)
        throw std::system_error(errno, std::system_category(), file);
    Reader reader(parser);
    std::string line;
    for (std::size_t number = 1; std::getline(in, line); ++number) {
        const std::string_view text = trimmed(line);
        if (text.empty() || text.starts_with('#'))
            continue;
        try {
            reader.take(text);
        } catch (const UsageError& error) {
            throw UsageError(file + ":" + std::to_string(number) + ": " + error.what());
        }
    }
    if (in.bad())
        throw std::runtime_error(file + ": it cannot be read");
}

} // namespace Tools
