// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An object manager may load the provider for all to see: whatever it exports beside its
// factories could take the place of somebody else's function.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <cstdio>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

namespace {

std::string outputOf(const std::string& command)
{
    const std::unique_ptr<FILE, int (*)(FILE*)> pipe(::popen(command.c_str(), "r"), ::pclose);
    std::string output;
    std::array<char, 4096> piece{};
    while (const std::size_t length = std::fread(piece.data(), 1, piece.size(), pipe.get()))
        output.append(piece.data(), length);
    return output;
}

// The names in `nm`'s lines of value, type and name.
std::vector<std::string> exportedNames(const std::string& library)
{
    std::istringstream lines(outputOf("nm -D --defined-only '" + library + "'"));
    std::vector<std::string> names;
    for (std::string value, type, name; lines >> value >> type >> name;)
        names.push_back(name);
    return names;
}

TEST(Exports, AreTheSixFactoriesAndNothingElse)
{
    EXPECT_THAT(exportedNames(SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileProvider.so"),
        testing::UnorderedElementsAre("SensorProfileProvider_Create_InstanceMI",
            "SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI",
            "SensorElementCapabilitiesProvider_Create_InstanceMI",
            "SensorElementCapabilitiesProvider_Create_AssociationMI",
            "SensorSystemDeviceProvider_Create_InstanceMI",
            "SensorSystemDeviceProvider_Create_AssociationMI"));
}

} // namespace
