// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The base of tests that run the tool.

#pragma once

#include "tests/support/TemporaryFolder.h"
#include "tests/support/Texts.h"
#include "tests/tools/ChildProcess.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

namespace Testing {

class ToolTest : public ::testing::Test {
protected:
    // Writes a model file with these nodes, given as JSON. Returns its path.
    std::string model(const std::string& nodes) const
    {
        return folder_.write("model.json", "{ \"nodes\": [" + nodes + "] }");
    }

    // Writes a model file with nodes of each type, in good and bad states. Returns its path.
    std::string smallModel() const
    {
        return model(R"(
            { "type": "temperature", "path": "/cpu0/temp1", "description": "CPU 1", "status": 1,
              "possibleStates": [1, 26], "baseUnits": 2, "reading": 41.5, "lowerNonCritical": 5,
              "upperNonCritical": 80, "upperCritical": 95, "lowerFatal": -10, "upperFatal": 105 },
            { "type": "temperature", "path": "/cpu1/temp1", "description": "CPU 2", "status": 26,
              "baseUnits": 2, "reading": 97, "upperCritical": 95 },
            { "type": "voltage", "path": "/board/in1", "description": "+12V", "status": 23,
              "baseUnits": 5, "reading": 12.75, "lowerCritical": 10.5, "upperNonCritical": 12.5 },
            { "type": "tachometer", "path": "/board/fan1", "description": "Fan", "status": 1,
              "baseUnits": 19, "reading": 1200, "lowerNonCritical": 300 },
            { "type": "tachometer", "path": "/board/fan2", "description": "Fan", "status": 13,
              "baseUnits": 19 })");
    }

    // Copies the tool, its server and its classes to a folder laid out as an installation, without
    // the libraries. Returns the path of the executable.
    std::string install() const
    {
        const auto moved = folder_.path() / "bin" / "sensorctl";
        const auto server = folder_.path() / "libexec" / "sensor-profile" / "sensorctl-serve";
        for (const auto& [from, to] :
            {std::pair(sensorctl, moved), {sensorctl + "-serve", server}}) {
            std::filesystem::create_directories(to.parent_path());
            std::filesystem::copy_file(from, to);
        }
        std::filesystem::copy(SENSOR_PROFILE_BINARY_DIR "/share", folder_.path() / "share",
            std::filesystem::copy_options::recursive);
        return moved.string();
    }

    TemporaryFolder folder_;
};

} // namespace Testing
