// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A subcommand of sensorctl.

#pragma once

#include <string>

namespace CLI {
class App;
}

namespace Tools {

class LibraryLog;
class Output;

enum class ExitCode {
    success = 0,
    failure = 1,      // with a message on standard error
    wrongUsage = 2,   // the command line is invalid
    nothingFound = 3, // success, but there is nothing to show
};

// A subclass adds its options to the parser in its constructor and reads them in run().
class Command {
public:
    // Adds the subcommand to the tool's command line, which must outlive it.
    Command(CLI::App& tool, const char* name, const char* description);
    virtual ~Command() = default;
    Command(const Command&) = delete;
    Command& operator=(const Command&) = delete;

    bool isChosen() const;

    // Throws UsageError for an invalid command line and another std::exception for any other
    // failure, with a text for the user.
    virtual ExitCode run(Output& out) = 0;

    // Reports why the command line is invalid or run() failed. Returns the exit code of the
    // process: the given one unless the command has other conventions.
    virtual ExitCode reportFailure(Output& out, const std::string& reason, ExitCode code) const;

    // Gives the command the libraries' log, which outlives run(). What the command does not take
    // from it is printed when run() has returned.
    virtual void useLog(LibraryLog& /*log*/) {}

    // Returns whether the libraries' log is a result of the command. It is collected otherwise.
    virtual bool writesLog() const { return false; }

protected:
    CLI::App& parser() const { return *parser_; }

private:
    CLI::App* parser_;
};

} // namespace Tools
