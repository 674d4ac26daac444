// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Runs prometheus-node-exporter with chosen collectors, on the present /sys.

#pragma once

#include "tests/support/HttpClient.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Texts.h"
#include "tests/support/WaitUntil.h"
#include "tests/tools/ChildProcess.h"

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <stdexcept>
#include <string>
#include <vector>

namespace Testing {

class NodeExporter {
public:
    explicit NodeExporter(const std::vector<std::string>& collectors = {"--collector.hwmon"})
    {
        std::vector<std::string> arguments = {"--collector.disable-defaults",
            "--web.disable-exporter-metrics", "--web.listen-address=127.0.0.1:0"};
        arguments.insert(arguments.end(), collectors.begin(), collectors.end());
        posix_spawn_file_actions_t actions{};
        ::posix_spawn_file_actions_init(&actions);
        ::posix_spawn_file_actions_addopen(
            &actions, STDERR_FILENO, log_.c_str(), O_WRONLY | O_CREAT, 0666);
        const int error =
            spawn(process_, "/usr/bin/prometheus-node-exporter", arguments, {}, actions);
        ::posix_spawn_file_actions_destroy(&actions);
        if (error == 0 && waitUntil([this] { return port() != 0; }))
            return;
        if (error == 0)
            end();
        throw std::runtime_error("prometheus-node-exporter: " + log());
    }
    ~NodeExporter() { end(); }
    NodeExporter(const NodeExporter&) = delete;
    NodeExporter& operator=(const NodeExporter&) = delete;

    std::string metrics() const
    {
        HttpClient client(port());
        client.send("GET /metrics HTTP/1.1\r\nHost: localhost\r\n\r\n");
        return client.receive().body;
    }

    std::string log() const { return contentOf(log_); }

private:
    void end() const
    {
        ::kill(process_, SIGKILL);
        ::waitpid(process_, nullptr, 0);
    }

    // Returns 0 until it listens.
    std::uint16_t port() const
    {
        const std::string log = this->log();
        const std::string before = "msg=\"Listening on\" address=127.0.0.1:";
        const std::size_t at = log.find(before);
        if (at == std::string::npos || log.find('\n', at) == std::string::npos)
            return 0;
        return static_cast<std::uint16_t>(std::stoi(log.substr(at + before.size())));
    }

    TemporaryFolder folder_;
    const std::string log_ = (folder_.path() / "log").string();
    ::pid_t process_ = -1;
};

} // namespace Testing
