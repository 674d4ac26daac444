// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The base of tests of the process that renews the file again and again.

#pragma once

#include "platform/instrumentation/ipmi/IpmiSource.h"
#include "tests/support/WaitUntil.h"
#include "tests/tools/collect/CollectTest.h"

#include <fcntl.h>
#include <signal.h> // NOLINT(modernize-deprecated-headers): <csignal> need not declare kill
#include <sys/wait.h>

#include <map>
#include <string>
#include <utility>
#include <vector>

namespace Testing {

class CollectProcessTest : public CollectTest {
protected:
    void start(const std::map<std::string, std::string>& variables = {})
    {
        launch({sensorctl}, variables);
        ASSERT_TRUE(waitUntil([this] { return std::filesystem::exists(file()); })) << errors();
    }

    // Starts a command that executes the tool, with the arguments of the tool.
    void launch(
        std::vector<std::string> command, const std::map<std::string, std::string>& variables = {})
    {
        auto environment = bmc_.environment();
        environment.insert(variables.begin(), variables.end());
        posix_spawn_file_actions_t actions{};
        ::posix_spawn_file_actions_init(&actions);
        ::posix_spawn_file_actions_addopen(&actions, STDERR_FILENO,
            (folder_.path() / "err").c_str(), O_WRONLY | O_CREAT | O_APPEND, 0600);
        const std::string program = command.front();
        command.erase(command.begin());
        for (const std::string& argument : arguments({"--interval", "1"}))
            command.push_back(argument);
        const int error = spawn(process_, program, command, environment, actions);
        ::posix_spawn_file_actions_destroy(&actions);
        ASSERT_EQ(error, 0);
    }

    ~CollectProcessTest() override { kill(); }

    void kill()
    {
        if (process_ == -1)
            return;
        ::kill(process_, SIGKILL);
        ::waitpid(process_, nullptr, 0);
        process_ = -1;
    }

    std::string errors() const { return contentOf(folder_.path() / "err"); }

    // Returns the name of the open device that the process has locked.
    std::string lockedDevice() const
    {
        const std::filesystem::path process = "/proc/" + std::to_string(process_);
        for (const auto& entry : std::filesystem::directory_iterator(process / "fd")) {
            std::error_code closed; // meanwhile
            const std::string target = std::filesystem::read_symlink(entry, closed).string();
            if (target.starts_with("socket:") &&
                contentOf(process / "fdinfo" / entry.path().filename()).find("FLOCK") !=
                    std::string::npos)
                return target;
        }
        return "";
    }

    // Waits for a file that fulfils the condition. Each is read once.
    template <typename Condition>
    bool waitForFile(const Condition& holds) const
    {
        std::filesystem::file_time_type seen;
        return waitUntil([&] {
            const auto written = std::filesystem::last_write_time(file());
            return std::exchange(seen, written) != written && holds(collected());
        });
    }

    bool waitForStatus(const std::string& description, unsigned status) const
    {
        return waitForFile([&](const Vorn::MachineFile& file) {
            return nodeOf(file, description).values.status == status;
        });
    }

    // Returns the numbers of commands of the passes, each of which begins with the repository's
    // information.
    std::vector<std::size_t> passes() const
    {
        std::vector<std::size_t> counts;
        for (const std::string& command : bmc_.answered()) {
            if (command.starts_with("0a 20"))
                counts.push_back(0);
            if (!counts.empty()) // the simulator has sent itself commands before
                ++counts.back();
        }
        return counts;
    }

    // Returns a table of the sensors that the provider publishes.
    std::string listed(const std::string& option = "--flat",
        std::map<std::string, std::string> variables = {}) const
    {
        variables["VORN_INSTRUMENTATION"] = "ipmi:" + file();
        return run({"list", option}, {.environment = variables}).out;
    }

    ::pid_t process_ = -1;
};

} // namespace Testing
