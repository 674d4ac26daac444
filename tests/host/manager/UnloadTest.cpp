// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Object managers unload idle providers and load them again at the next request, for years: no
// memory, descriptor or mapping may be left.

#include "host/broker/Broker.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "host/broker/Result.h"
#include "host/manager/ProviderLibrary.h"
#include "tests/support/Environment.h"
#include "tests/support/ProcessState.h"
#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>

namespace UnloadTests {

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
constexpr bool isSanitized = true;
#elif defined(__has_feature)
constexpr bool isSanitized = __has_feature(address_sanitizer) || __has_feature(thread_sanitizer);
#else
constexpr bool isSanitized = false;
#endif

const std::string provider = SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileProvider.so";

constexpr const char* model = R"({ "nodes": [
    { "type": "temperature", "path": "/board/temp1", "description": "Temp", "status": 1,
      "baseUnits": 2, "reading": 41.5, "upperCritical": 95, "possibleStates": [1, 26] },
    { "type": "voltage", "path": "/board/in1", "description": "+12V", "status": 1,
      "baseUnits": 5, "reading": 12.1 },
    { "type": "tachometer", "path": "/board/fan1", "description": "Fan", "status": 1,
      "baseUnits": 19, "reading": 1200 } ] })";

// Loads the provider, enumerates the sensors and unloads it.
void enumerate(std::size_t& count)
{
    Host::Broker broker;
    Host::ProviderLibrary library(broker, provider);
    Host::Request request(broker);
    CMPIInstanceMI& mi = library.createInstanceMI("SensorProfileProvider");
    Host::CollectedResult answer;
    Host::Result result(answer);
    const CMPIStatus status = mi.ft->enumerateInstances(&mi, request.context().handle(),
        result.handle(), request.makePath("root/cimv2", "ZUMLO_NumericSensor").handle(), nullptr);
    ASSERT_EQ(status.rc, CMPI_RC_OK);
    count = answer.instances().size();
}

std::size_t lines(const char* file)
{
    std::ifstream in(file);
    return static_cast<std::size_t>(
        std::count(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>(), '\n'));
}

class UnloadTest : public testing::Test {
protected:
    // Loads and unloads the provider many times on the machine that VORN_INSTRUMENTATION names.
    void useManyTimes(const std::string& instrumentation, std::size_t sensors)
    {
        constexpr int uses = isSanitized ? 100 : 1000;
        constexpr int warmUp = uses / 10;
        constexpr std::size_t tolerance = std::size_t{1} << 20; // less than a kilobyte per use
        const Testing::EnvironmentVariable machine("VORN_INSTRUMENTATION", instrumentation);
        const Testing::EnvironmentVariable level("RYNLOG_LEVEL", "3000");
        const Testing::EnvironmentVariable log("RYNLOG_LOG", "file:" + path("log"));
        const Testing::EnvironmentVariable trace("RYNLOG_TRACE", "file:" + path("trace"));

        use(warmUp, sensors);
        const std::size_t sizeBefore = Testing::residentBytes();
        const std::size_t mappingsBefore = lines("/proc/self/maps");
        const std::size_t descriptorsBefore = Testing::openDescriptors();
        use(uses - warmUp, sensors);

        EXPECT_FALSE(Testing::isMapped(provider));
        EXPECT_EQ(Testing::openDescriptors(), descriptorsBefore);
        EXPECT_GT(std::filesystem::file_size(path("trace")), 0U);
        if (isSanitized)
            return; // the sanitizer's own memory grows
        EXPECT_LE(Testing::residentBytes(), sizeBefore + tolerance);
        EXPECT_LE(lines("/proc/self/maps"), mappingsBefore + 2);
    }

    std::string path(const char* name) const { return (folder_.path() / name).string(); }

    Testing::TemporaryFolder folder_;

private:
    static void use(int times, std::size_t sensors)
    {
        for (int i = 0; i < times; ++i) {
            std::size_t count = 0;
            ASSERT_NO_FATAL_FAILURE(enumerate(count));
            ASSERT_EQ(count, sensors);
        }
    }
};

TEST_F(UnloadTest, ProviderLeavesMemoryAfterOneUse)
{
    const Testing::EnvironmentVariable machine(
        "VORN_INSTRUMENTATION", "model:" + folder_.write("model.json", model));
    std::size_t count = 0;
    ASSERT_NO_FATAL_FAILURE(enumerate(count));
    EXPECT_EQ(count, 3U);
    EXPECT_FALSE(Testing::isMapped(provider));
}

TEST_F(UnloadTest, ThousandUsesOnAModelLeaveNothingBehind)
{
    useManyTimes("model:" + folder_.write("model.json", model), 3);
}

// This machine may have sensors or none.
TEST_F(UnloadTest, ThousandUsesOnThisMachineLeaveNothingBehind)
{
    std::size_t sensors = 0;
    {
        const Testing::EnvironmentVariable machine("VORN_INSTRUMENTATION", "hwmon");
        ASSERT_NO_FATAL_FAILURE(enumerate(sensors));
    }
    useManyTimes("hwmon,model:" + folder_.write("model.json", model), sensors + 3);
}

} // namespace UnloadTests
