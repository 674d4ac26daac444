// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/tools/ChildProcess.h"

#include <fcntl.h>
#include <poll.h>
#include <pty.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <set>
#include <stdexcept>
#include <system_error>
#include <utility>

namespace Testing {

namespace {

void check(int error)
{
    if (error != 0)
        throw std::system_error(error, std::generic_category());
}

class Descriptor {
public:
    explicit Descriptor(int number = -1) : number_(number) {}
    ~Descriptor() { close(); }
    Descriptor(Descriptor&& other) noexcept : number_(std::exchange(other.number_, -1)) {}
    Descriptor& operator=(Descriptor&&) = delete;

    int number() const { return number_; }
    void close()
    {
        if (number_ != -1)
            ::close(std::exchange(number_, -1));
    }

private:
    int number_;
};

struct Pipe {
    Descriptor read;
    Descriptor write;
};

Pipe makePipe()
{
    std::array<int, 2> ends{};
    if (::pipe2(ends.data(), O_CLOEXEC) != 0)
        check(errno);
    return {Descriptor(ends[0]), Descriptor(ends[1])};
}

// Texts and the pointers to them that exec takes.
class Strings {
public:
    explicit Strings(std::vector<std::string> texts) : texts_(std::move(texts))
    {
        for (std::string& text : texts_)
            pointers_.push_back(text.data());
        pointers_.push_back(nullptr);
    }
    Strings(const Strings&) = delete;
    Strings& operator=(const Strings&) = delete;

    char* const* pointers() const { return pointers_.data(); }

private:
    std::vector<std::string> texts_;
    std::vector<char*> pointers_;
};

std::vector<std::string> commandOf(
    const std::string& program, const std::vector<std::string>& arguments)
{
    std::vector<std::string> command = {program};
    command.insert(command.end(), arguments.begin(), arguments.end());
    return command;
}

std::vector<std::string> entriesOf(const std::map<std::string, std::string>& variables)
{
    std::vector<std::string> entries;
    for (const auto& [name, value] : variables)
        entries.push_back(name + "=" + value);
    return entries;
}

std::map<std::string, std::string> environmentWith(
    const std::map<std::string, std::string>& changes)
{
    static const std::set<std::string> withheld = {
        "VORN_INSTRUMENTATION", "COLUMNS", "NO_COLOR", "TERM"};
    static const std::map<std::string, std::string> defaults = {
        {"LC_ALL", "C"}, {"RYNLOG_LOG", "off"}, {"RYNLOG_TRACE", "off"}};
    std::map<std::string, std::string> variables;
    for (char** entry = environ; *entry != nullptr; ++entry) {
        const std::string text = *entry;
        const std::string name = text.substr(0, text.find('='));
        if (!withheld.contains(name))
            variables[name] = text.substr(name.size() + 1);
    }
    for (const auto& settings : {defaults, changes})
        for (const auto& [name, value] : settings)
            variables[name] = value;
    return variables;
}

// The actions of posix_spawn on the child's descriptors.
class Actions {
public:
    Actions() { check(::posix_spawn_file_actions_init(&actions_)); }
    ~Actions() { ::posix_spawn_file_actions_destroy(&actions_); }
    Actions(const Actions&) = delete;
    Actions& operator=(const Actions&) = delete;

    const posix_spawn_file_actions_t& get() const { return actions_; }
    void duplicate(int from, int to)
    {
        check(::posix_spawn_file_actions_adddup2(&actions_, from, to));
    }
    void close(int descriptor)
    {
        check(::posix_spawn_file_actions_addclose(&actions_, descriptor));
    }
    void open(int descriptor, const std::string& file)
    {
        check(::posix_spawn_file_actions_addopen(
            &actions_, descriptor, file.c_str(), O_WRONLY | O_CREAT, 0666));
    }

private:
    posix_spawn_file_actions_t actions_{};
};

void directOutput(Actions& actions, const RunOptions& options, const Pipe& pipe)
{
    switch (options.out) {
    case RunOptions::Out::captured:
    case RunOptions::Out::abandonedPipe:
        actions.duplicate(pipe.write.number(), STDOUT_FILENO);
        break;
    case RunOptions::Out::file:
        actions.open(STDOUT_FILENO, options.outFile);
        break;
    case RunOptions::Out::closed:
        actions.close(STDOUT_FILENO);
        break;
    }
}

// Appends the available bytes. Returns false at the end, which a terminal reports as an error when
// its other side is closed.
bool readSome(int descriptor, std::string& text)
{
    std::array<char, 65536> piece{};
    const ssize_t length = ::read(descriptor, piece.data(), piece.size());
    if (length > 0)
        text.append(piece.data(), static_cast<std::size_t>(length));
    return length > 0;
}

// Reads both descriptors to their ends.
void readBoth(int first, std::string& firstText, int second, std::string& secondText)
{
    std::array<pollfd, 2> waiting = {pollfd{first, POLLIN, 0}, pollfd{second, POLLIN, 0}};
    const std::array<std::string*, 2> texts = {&firstText, &secondText};
    while (waiting[0].fd != -1 || waiting[1].fd != -1) {
        if (::poll(waiting.data(), waiting.size(), -1) < 0)
            continue;
        for (std::size_t i = 0; i < waiting.size(); ++i)
            if (waiting[i].fd != -1 && waiting[i].revents != 0 &&
                !readSome(waiting[i].fd, *texts[i]))
                waiting[i].fd = -1;
    }
}

void waitFor(pid_t child, Ended& ended)
{
    int status = 0;
    while (::waitpid(child, &status, 0) < 0)
        if (errno != EINTR)
            check(errno);
    if (WIFEXITED(status))
        ended.code = WEXITSTATUS(status);
    else
        ended.signal = WTERMSIG(status);
}

} // namespace

int spawn(::pid_t& child, const std::string& program, const std::vector<std::string>& arguments,
    const std::map<std::string, std::string>& variables, const posix_spawn_file_actions_t& actions)
{
    const Strings command(commandOf(program, arguments));
    const Strings entries(entriesOf(variables));
    return ::posix_spawn(
        &child, program.c_str(), &actions, nullptr, command.pointers(), entries.pointers());
}

Ended run(const std::vector<std::string>& arguments, const RunOptions& options)
{
    Pipe out = makePipe();
    Pipe err = makePipe();
    Actions actions;
    directOutput(actions, options, out);
    actions.duplicate(err.write.number(), STDERR_FILENO);
    if (options.out == RunOptions::Out::abandonedPipe)
        out.read.close();

    pid_t child = 0;
    check(spawn(
        child, options.program, arguments, environmentWith(options.environment), actions.get()));
    out.write.close();
    err.write.close();
    Ended ended;
    readBoth(out.read.number(), ended.out, err.read.number(), ended.err);
    waitFor(child, ended);
    return ended;
}

Ended runOnTerminal(const std::vector<std::string>& arguments, unsigned short columns,
    const std::map<std::string, std::string>& environment)
{
    const Strings command(commandOf(sensorctl, arguments));
    const Strings variables(entriesOf(environmentWith(environment)));
    const winsize size = {24, columns, 0, 0};
    int terminal = -1;
    const pid_t child = ::forkpty(&terminal, nullptr, nullptr, &size);
    if (child < 0)
        check(errno);
    if (child == 0) {
        ::execve(sensorctl.c_str(), command.pointers(), variables.pointers());
        ::_exit(127);
    }
    const Descriptor closesTerminal(terminal);
    Ended ended;
    while (readSome(terminal, ended.out)) {}
    waitFor(child, ended);
    return ended;
}

} // namespace Testing
