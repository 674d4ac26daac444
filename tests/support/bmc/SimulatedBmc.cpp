// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/support/bmc/SimulatedBmc.h"

#include "tests/support/Texts.h"
#include "tests/support/WaitUntil.h"

#include <arpa/inet.h>
#include <fcntl.h>
#include <poll.h>
#include <signal.h> // NOLINT(modernize-deprecated-headers): <csignal> need not declare kill
#include <spawn.h>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <fstream>
#include <stdexcept>
#include <system_error>

namespace Testing {

namespace {

class Socket {
public:
    Socket() : number_(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)) {}
    ~Socket() { ::close(number_); }
    Socket(const Socket&) = delete;
    Socket& operator=(const Socket&) = delete;

    int number() const { return number_; }

    bool connect(std::uint16_t port) const
    {
        const sockaddr_in address = loopback(port);
        return ::connect(number_, reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0;
    }

    // Returns a port that nobody uses.
    std::uint16_t bindToAny() const
    {
        sockaddr_in address = loopback(0);
        socklen_t size = sizeof address;
        if (::bind(number_, reinterpret_cast<const sockaddr*>(&address), size) != 0 ||
            ::getsockname(number_, reinterpret_cast<sockaddr*>(&address), &size) != 0)
            throw std::system_error(errno, std::generic_category());
        return ntohs(address.sin_port);
    }

private:
    static sockaddr_in loopback(std::uint16_t port)
    {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_port = htons(port);
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        return address;
    }

    int number_;
};

// Reads until the prompt of the console.
std::string readToPrompt(const Socket& console)
{
    constexpr int timeout = 5000; // in milliseconds
    std::string text;
    std::array<char, 4096> block{};
    while (!text.ends_with("> ")) {
        pollfd input{console.number(), POLLIN, 0};
        const ssize_t count = ::poll(&input, 1, timeout) == 1
                                  ? ::recv(console.number(), block.data(), block.size(), 0)
                                  : 0;
        if (count <= 0)
            throw std::runtime_error("the console does not respond: " + text);
        text.append(block.data(), static_cast<std::size_t>(count));
    }
    return text;
}

} // namespace

SimulatedBmc::SimulatedBmc(const std::string& emulation)
{
    {
        const Socket system; // both are bound at the same time, so that the ports differ
        const Socket console;
        systemPort_ = system.bindToAny();
        consolePort_ = console.bindToAny();
    }
    folder_.write("bmc.emu", emulation);
    folder_.write("lan.conf", "name \"bmc\"\nset_working_mc 0x20\nserial 15 127.0.0.1 " +
                                  std::to_string(systemPort_) + " codec VM\nconsole 127.0.0.1 " +
                                  std::to_string(consolePort_) + "\n");
    folder_.write("faults", "");
    start();
}

SimulatedBmc::~SimulatedBmc()
{
    stop();
}

std::map<std::string, std::string> SimulatedBmc::environment() const
{
    return {{"LD_PRELOAD", BMC_DEVICE}, {"SIMULATED_BMC", std::to_string(systemPort_)}};
}

void SimulatedBmc::start()
{
    const std::string folder = folder_.path().string();
    std::vector<std::string> arguments = {"ipmi_sim", "-n", "-p", "-c", folder + "/lan.conf", "-f",
        folder + "/bmc.emu", "-s", folder + "/state"};
    std::vector<std::string> variables = {"PATH=/usr/bin:/bin", "LD_PRELOAD=" BMC_SIMULATOR,
        "BMC_COMMANDS=" + folder + "/commands", "BMC_FAULTS=" + folder + "/faults"};
    const auto pointersOf = [](std::vector<std::string>& texts) {
        std::vector<char*> pointers;
        for (std::string& text : texts)
            pointers.push_back(text.data());
        pointers.push_back(nullptr);
        return pointers;
    };
    std::filesystem::create_directories(folder + "/state");
    posix_spawn_file_actions_t actions{};
    ::posix_spawn_file_actions_init(&actions);
    ::posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
    ::posix_spawn_file_actions_addopen(
        &actions, STDOUT_FILENO, (folder + "/log").c_str(), O_WRONLY | O_CREAT | O_APPEND, 0600);
    ::posix_spawn_file_actions_adddup2(&actions, STDOUT_FILENO, STDERR_FILENO);
    // The simulator would be ended by a client that disconnects while it is suspended.
    struct sigaction ignoring {};
    struct sigaction before {};
    ignoring.sa_handler = SIG_IGN;
    ::sigaction(SIGPIPE, &ignoring, &before);
    const int error = ::posix_spawnp(&process_, "ipmi_sim", &actions, nullptr,
        pointersOf(arguments).data(), pointersOf(variables).data());
    ::sigaction(SIGPIPE, &before, nullptr);
    ::posix_spawn_file_actions_destroy(&actions);
    if (error != 0)
        throw std::system_error(error, std::generic_category(), "ipmi_sim");
    if (!waitUntil([this] { return Socket().connect(systemPort_); }))
        throw std::runtime_error("ipmi_sim: " + contentOf(folder_.path() / "log"));
}

void SimulatedBmc::stop()
{
    if (process_ == -1)
        return;
    ::kill(process_, SIGKILL);
    ::waitpid(process_, nullptr, 0);
    process_ = -1;
}

void SimulatedBmc::suspend() const
{
    ::kill(process_, SIGSTOP);
}

void SimulatedBmc::resume() const
{
    ::kill(process_, SIGCONT);
}

void SimulatedBmc::command(const std::string& line) const
{
    const Socket console;
    if (!console.connect(consolePort_))
        throw std::runtime_error("the console cannot be reached");
    readToPrompt(console);
    const std::string text = line + "\n";
    (void)::send(console.number(), text.data(), text.size(), MSG_NOSIGNAL);
    const std::string answer = readToPrompt(console);
    if (answer.find("**") != std::string::npos)
        throw std::runtime_error(answer);
}

void SimulatedBmc::setFaults(const std::string& lines) const
{
    folder_.write("faults.new", lines);
    std::filesystem::rename(folder_.path() / "faults.new", folder_.path() / "faults");
}

std::vector<std::string> SimulatedBmc::answered() const
{
    std::vector<std::string> lines;
    std::ifstream file(folder_.path() / "commands");
    for (std::string line; std::getline(file, line);)
        lines.push_back(line);
    return lines;
}

} // namespace Testing
