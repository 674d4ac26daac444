// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A machine with any number of sensors, described by a model file in a temporary folder.

#pragma once

#include "platform/instrumentation/Instrumentation.h"
#include "tests/support/Environment.h"
#include "tests/support/TemporaryFolder.h"

#include <array>
#include <chrono>
#include <cstdint>
#include <string>
#include <thread>

namespace Bench {

class ModelMachine {
public:
    explicit ModelMachine(std::int64_t sensors)
        : environment_(
              "VORN_INSTRUMENTATION", "model:" + folder_.write("model.json", content(sensors)))
    {
        // A file that has just changed is parsed at each request; the measurement begins after
        // that.
        std::this_thread::sleep_for(std::chrono::milliseconds(100));
        Vorn::Instrumentation().selectNode(Vorn::NodeLexicon::NodeType::Temperature);
    }

    // Returns the device identifier of a sensor in the middle of the file.
    static std::string someDeviceID(std::int64_t sensors)
    {
        const std::string number = std::to_string(sensors / 2);
        return "Sensor " + number + ":/board/" + number;
    }

private:
    static std::string content(std::int64_t sensors)
    {
        constexpr std::array<const char*, 3> types = {"temperature", "voltage", "tachometer"};
        std::string text = R"({"nodes": [)";
        for (std::int64_t i = 0; i < sensors; ++i) {
            const std::string number = std::to_string(i);
            text += i == 0 ? "" : ",\n";
            text += R"({"type": ")";
            text += types.at(static_cast<std::size_t>(i) % types.size());
            text += R"(", "path": "/board/)" + number + R"(", "description": "Sensor )" + number +
                    R"(", "status": 1, "possibleStates": [1, 23, 26], "baseUnits": 2, )"
                    R"("reading": 41.5, "lowerNonCritical": 5, "upperNonCritical": 80, )"
                    R"("lowerCritical": 1, "upperCritical": 95})";
        }
        return text + "]}";
    }

    Testing::TemporaryFolder folder_;
    Testing::EnvironmentVariable environment_;
};

} // namespace Bench
