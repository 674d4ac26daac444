// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "bench/ServerProcess.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <csignal>
#include <fstream>
#include <memory>
#include <stdexcept>
#include <vector>

namespace Bench {

namespace {

struct CloseDescriptor {
    int descriptor;
    ~CloseDescriptor() { ::close(descriptor); }
};

// Returns the first line, which the program writes when it is ready.
std::string readLine(int descriptor)
{
    std::string line;
    for (char next = 0; ::read(descriptor, &next, 1) == 1 && next != '\n';)
        line += next;
    return line;
}

::pid_t start(int output)
{
    const std::string program = SENSOR_PROFILE_BINARY_DIR "/bin/sensorctl";
    std::vector<std::string> words = {program, "serve", "--port=0", "--address=127.0.0.1"};
    if (::geteuid() == 0)
        words.emplace_back("--user=root"); // only root can read the machine's model
    std::vector<char*> arguments;
    arguments.reserve(words.size() + 1);
    for (std::string& word : words)
        arguments.push_back(word.data());
    arguments.push_back(nullptr);
    ::posix_spawn_file_actions_t actions;
    ::posix_spawn_file_actions_init(&actions);
    const std::unique_ptr<::posix_spawn_file_actions_t, int (*)(::posix_spawn_file_actions_t*)>
        owner(&actions, ::posix_spawn_file_actions_destroy);
    ::posix_spawn_file_actions_adddup2(&actions, output, STDOUT_FILENO);
    ::posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, "/dev/null", O_WRONLY, 0);
    ::pid_t pid = -1;
    if (::posix_spawn(&pid, program.c_str(), &actions, nullptr, arguments.data(), environ) != 0)
        throw std::runtime_error(program + " cannot be started");
    return pid;
}

} // namespace

ServerProcess::ServerProcess()
{
    std::array<int, 2> ends{};
    if (::pipe2(ends.data(), O_CLOEXEC) != 0)
        throw std::runtime_error("no pipe");
    const CloseDescriptor reading{ends[0]};
    const auto begin = std::chrono::steady_clock::now();
    {
        const CloseDescriptor writing{ends[1]};
        pid_ = start(ends[1]);
    }
    const std::string line = readLine(ends[0]);
    startUp_ = std::chrono::steady_clock::now() - begin;
    const auto colon = line.rfind(':');
    if (line.find("http://") == std::string::npos)
        throw std::runtime_error("the server does not serve");
    port_ = static_cast<std::uint16_t>(std::stoul(line.substr(colon + 1)));
}

ServerProcess::~ServerProcess()
{
    ::kill(pid_, SIGKILL);
    ::waitpid(pid_, nullptr, 0);
}

std::size_t ServerProcess::memory(const std::string& entry) const
{
    std::ifstream status("/proc/" + std::to_string(pid_) + "/status");
    for (std::string word; status >> word;)
        if (word == entry) {
            std::size_t size = 0;
            status >> size;
            return size;
        }
    throw std::runtime_error("the server has ended");
}

} // namespace Bench
