// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/tools/ServerProcess.h"

#include "tests/support/Texts.h"
#include "tests/support/WaitUntil.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <csignal>
#include <stdexcept>
#include <system_error>

namespace Testing {

namespace {

bool names(const std::vector<std::string>& arguments, const std::string& option)
{
    return std::find(arguments.begin(), arguments.end(), option) != arguments.end();
}

std::vector<std::string> completed(std::vector<std::string> arguments)
{
    const bool isConfigured = names(arguments, "--config");
    if (!isConfigured && !names(arguments, "--port"))
        arguments.insert(arguments.end(), {"--port", "0"});
    if (!isConfigured && !names(arguments, "--tls-port"))
        arguments.insert(arguments.end(), {"--tls-port", "0"});
    if (::geteuid() == 0 && !isConfigured && !names(arguments, "--user"))
        arguments.insert(arguments.end(), {"--user", "root"});
    arguments.insert(arguments.begin(), "serve");
    return arguments;
}

} // namespace

ServerProcess::ServerProcess(std::vector<std::string> arguments,
    const std::map<std::string, std::string>& environment, const std::string& program)
{
    std::map<std::string, std::string> variables{{"LC_ALL", "C"}, {"PATH", "/usr/bin:/bin"}};
    for (const auto& [name, value] : environment)
        variables[name] = value;
    posix_spawn_file_actions_t actions{};
    ::posix_spawn_file_actions_init(&actions);
    for (const auto& [descriptor, name] : {std::pair(STDOUT_FILENO, "out"), {STDERR_FILENO, "err"}})
        ::posix_spawn_file_actions_addopen(&actions, descriptor, (folder_.path() / name).c_str(),
            O_WRONLY | O_CREAT | O_APPEND, 0666);
    const int error = spawn(process_, program, completed(std::move(arguments)), variables, actions);
    ::posix_spawn_file_actions_destroy(&actions);
    if (error != 0)
        throw std::system_error(error, std::generic_category());
    const bool isUp =
        waitUntil([this] { return output().find("Try: ") != std::string::npos || hasEnded(); });
    if (!isUp || process_ == -1) {
        const std::string reason = isUp ? log() : "nothing was printed";
        if (process_ != -1)
            end(SIGKILL);
        throw std::runtime_error(reason);
    }
}

ServerProcess::~ServerProcess()
{
    if (process_ == -1)
        return;
    ::kill(process_, SIGKILL);
    ::waitpid(process_, nullptr, 0);
}

std::string ServerProcess::output() const
{
    return contentOf(folder_.path() / "out");
}

std::string ServerProcess::log() const
{
    return contentOf(folder_.path() / "err");
}

std::uint16_t ServerProcess::port(const std::string& scheme) const
{
    const std::string text = output();
    const std::size_t address = text.find(" " + scheme + "://");
    if (address == std::string::npos)
        throw std::runtime_error("no address was printed: " + scheme);
    const std::size_t end = text.find_first_of(" \n", address + 1);
    const std::size_t colon = text.rfind(':', end);
    return static_cast<std::uint16_t>(std::stoul(text.substr(colon + 1, end - colon - 1)));
}

std::size_t ServerProcess::residentKilobytes() const
{
    const std::string status = contentOf("/proc/" + std::to_string(process_) + "/status");
    return std::stoul(status.substr(status.find("VmRSS:") + 6));
}

void ServerProcess::signal(int number) const
{
    ::kill(process_, number);
}

bool ServerProcess::waitForLog(const std::string& text) const
{
    return waitUntil([&] { return log().find(text) != std::string::npos; });
}

Ended ServerProcess::wait()
{
    if (!waitUntil([this] { return hasEnded(); }))
        throw std::runtime_error("the server does not end");
    ended_.out = output();
    ended_.err = log();
    return ended_;
}

bool ServerProcess::hasEnded()
{
    int status = 0;
    if (process_ == -1 || ::waitpid(process_, &status, WNOHANG) != process_)
        return process_ == -1;
    process_ = -1;
    ended_.code = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    ended_.signal = WIFSIGNALED(status) ? WTERMSIG(status) : 0;
    return true;
}

} // namespace Testing
