// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// One subcommand: its part of the command line, and its work.

#pragma once

namespace CLI {
class App;
}

namespace Tools {

class Output;

enum class ExitCode {
    success = 0,
    failure = 1,      // a message on standard error says why
    wrongUsage = 2,   // the command line makes no sense
    nothingFound = 3, // all went well, but there is nothing to show
};

// A subclass adds its options to the parser when it is made, and reads them when it runs.
class Command {
public:
    // Adds the subcommand to the tool's command line, which must outlive it.
    Command(CLI::App& tool, const char* name, const char* description);
    virtual ~Command() = default;
    Command(const Command&) = delete;
    Command& operator=(const Command&) = delete;

    bool isChosen() const;

    // Does the work. Throws std::exception with the text for the user when it fails, UsageError
    // when the reason is what was typed.
    virtual ExitCode run(Output& out) = 0;

protected:
    CLI::App& parser() const { return *parser_; }

private:
    CLI::App* parser_;
};

} // namespace Tools
