// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The servers that clients are tested with, one for each machine and scheme.

#pragma once

#include "tests/support/MountNamespace.h"
#include "tests/support/TlsClient.h"
#include "tests/tools/ServerProcess.h"
#include "tests/tools/ToolTest.h"

#include <nlohmann/json.hpp>

#include <sys/stat.h>

#include <map>
#include <optional>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

namespace Testing {

// The options of a server with TLS whose clients sign in as ann.
class Encryption {
public:
    Encryption()
    {
        makeCertificate(file_, "localhost");
        // The password of ann is "secret"; its hash has the least cost.
        passwords_ = folder_.write(
            "passwords", "ann:$2b$04$abcdefghijklmnopqrstuu2r9OfJnfCsdneAXAGHnS4UpFFP8WIrW\n");
        ::chmod(passwords_.c_str(), 0600);
    }

    std::vector<std::string> options() const
    {
        return {"--certificate", file_ + ".crt", "--key", file_ + ".key", "--passwords", passwords_,
            "--sign-in-delay", "1"};
    }

private:
    TemporaryFolder folder_;
    std::string file_ = (folder_.path() / "one").string();
    std::string passwords_;
};

using Place = std::tuple<std::string, std::string>; // a machine's name and a scheme

// Returns the options that select a machine.
inline std::vector<std::string> optionsOf(const std::string& machine)
{
    if (machine == "demonstration")
        return {"--model", SENSOR_PROFILE_SOURCE_DIR "/schema/demo-model.json"};
    return {};
}

// The servers and results that all tests share, since no request changes them.
class Machines {
public:
    ServerProcess& server(const Place& place)
    {
        const auto& [machine, scheme] = place;
        std::vector<std::string> options = optionsOf(machine);
        if (options.empty() && !sysfs_)
            sysfs_.emplace(machine);
        if (scheme == "https") {
            const auto more = encryption_.options();
            options.insert(options.end(), more.begin(), more.end());
        }
        return servers_.try_emplace(place, options).first->second;
    }

    // Returns the objects of a class as the tool prints them.
    const nlohmann::json& listed(const std::string& machine, const std::string& name)
    {
        nlohmann::json& instances = listed_[{machine, name}];
        if (instances.is_null()) {
            std::vector<std::string> arguments = {"list", name, "--cim"};
            const auto options = optionsOf(machine);
            arguments.insert(arguments.end(), options.begin(), options.end());
            const Ended ended = run(arguments);
            EXPECT_EQ(ended.code, 0) << ended.err;
            instances = nlohmann::json::parse(ended.out).at("instances");
        }
        return instances;
    }

private:
    Encryption encryption_;
    std::optional<BoundSysfs> sysfs_;
    std::map<Place, ServerProcess> servers_;
    std::map<std::pair<std::string, std::string>, nlohmann::json> listed_;
};

} // namespace Testing
