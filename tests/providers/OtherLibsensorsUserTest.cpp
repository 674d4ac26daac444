// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A program that uses libsensors and has the provider library loaded, as an object manager with
// another plugin does.

#include "host/broker/Broker.h"
#include "tests/providers/Factories.h"
#include "tests/providers/SensorRequest.h"
#include "tests/support/Environment.h"
#include "tests/support/MountNamespace.h"

#include <dlfcn.h>
#include <gmock/gmock.h>
#include <sensors/error.h>
#include <sensors/sensors.h>

#include <memory>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace OtherLibsensorsUserTests {

using Testing::BoundSensorsConfiguration;
using Testing::BoundSysfs;
using testing::SizeIs;

// The program's own use of libsensors: it keeps pointers into the list of chips.
class Program {
public:
    Program() { EXPECT_EQ(sensors_init(nullptr), 0); }
    ~Program() { sensors_cleanup(); }
    Program(const Program&) = delete;
    Program& operator=(const Program&) = delete;

    // Returns the number of chips that are listed now.
    static std::size_t chips()
    {
        int position = 0;
        while (sensors_get_detected_chips(nullptr, &position) != nullptr) {}
        return static_cast<std::size_t>(position);
    }

    // Returns what the subfeatures read, by the pointers of the first call.
    std::vector<double> readings()
    {
        if (inputs_.empty())
            findInputs();
        std::vector<double> found;
        for (const Input& input : inputs_) {
            double value = 0.0;
            EXPECT_EQ(sensors_get_value(input.chip, input.subfeature->number, &value), 0);
            found.push_back(value);
        }
        return found;
    }

private:
    struct Input {
        const sensors_chip_name* chip;
        const sensors_subfeature* subfeature;
    };

    void findInputs()
    {
        int position = 0;
        while (const sensors_chip_name* chip = sensors_get_detected_chips(nullptr, &position)) {
            int featurePosition = 0;
            while (const sensors_feature* feature = sensors_get_features(chip, &featurePosition))
                inputs_.push_back(
                    {chip, sensors_get_subfeature(chip, feature, SENSORS_SUBFEATURE_TEMP_INPUT)});
        }
    }

    std::vector<Input> inputs_;
};

// The provider library, loaded as an object manager loads it.
class Provider {
public:
    Provider()
        : library_(::dlopen(SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileProvider.so", RTLD_NOW),
              &::dlclose)
    {
        if (library_ == nullptr)
            throw std::runtime_error(::dlerror());
        const auto create = reinterpret_cast<Testing::InstanceFactory>(
            ::dlsym(library_.get(), "SensorProfileProvider_Create_InstanceMI"));
        mi_ = create(broker_.handle(), nullptr, nullptr);
    }

    // Returns the number of sensors in the answer to EnumInstances.
    std::size_t sensors() { return Testing::SensorRequest(broker_, mi_).instances().size(); }

private:
    Host::Broker broker_;
    std::unique_ptr<void, int (*)(void*)> library_;
    CMPIInstanceMI* mi_ = nullptr;
};

// The machine has three temperatures, one on each chip.
class OtherLibsensorsUserTest : public Testing::MountNamespaceTest {
protected:
    void SetUp() override
    {
        MountNamespaceTest::SetUp();
        if (IsSkipped() || HasFailure())
            return;
        configuration_.emplace("");
        sysfs_.emplace("hotplug");
    }

    // Adds a chip with a sensor, so that the provider renews its list at the next request.
    void plugIn(const std::string& name)
    {
        sysfs_->addChip("hwmon-" + name, name, "platform", name + ".1");
        sysfs_->write("hwmon/hwmon-" + name + "/temp1_input", "20000\n");
    }

private:
    Testing::EnvironmentVariable hardware_{"VORN_INSTRUMENTATION", "hwmon"};
    std::optional<BoundSensorsConfiguration> configuration_;
    std::optional<BoundSysfs> sysfs_;
};

TEST_F(OtherLibsensorsUserTest, KeepsItsChipsWhileRequestsRenewTheirs)
{
    Program program;
    const auto readings = program.readings();
    ASSERT_THAT(readings, SizeIs(3));
    Provider provider;
    EXPECT_EQ(provider.sensors(), 3U);
    EXPECT_EQ(Program::chips(), 3U);
    EXPECT_EQ(program.readings(), readings);
    plugIn("newcomer");
    EXPECT_EQ(provider.sensors(), 4U);
    EXPECT_EQ(Program::chips(), 3U);
    EXPECT_EQ(program.readings(), readings);
}

TEST_F(OtherLibsensorsUserTest, RequestsKeepTheirChipsWhileItCleansUpAndBeginsAnew)
{
    Provider provider;
    EXPECT_EQ(provider.sensors(), 3U);
    for (int time = 0; time < 2; ++time) {
        Program program;
        EXPECT_EQ(Program::chips(), 3U);
        EXPECT_EQ(provider.sensors(), 3U);
        EXPECT_THAT(program.readings(), SizeIs(3));
    }
    EXPECT_EQ(Program::chips(), 0U);
    EXPECT_EQ(provider.sensors(), 3U);
}

TEST_F(OtherLibsensorsUserTest, KeepsItsChipsWhenTheProviderIsUnloaded)
{
    Program program;
    const auto readings = program.readings();
    for (int time = 0; time < 2; ++time) {
        Provider provider;
        EXPECT_EQ(provider.sensors(), 3U);
    }
    EXPECT_EQ(program.readings(), readings);
}

TEST_F(OtherLibsensorsUserTest, KeepsItsErrorHandlers)
{
    const auto parseError = sensors_parse_error_wfn;
    const auto fatalError = sensors_fatal_error;
    Provider provider;
    EXPECT_EQ(provider.sensors(), 3U);
    EXPECT_EQ(sensors_parse_error_wfn, parseError);
    EXPECT_EQ(sensors_fatal_error, fatalError);
}

} // namespace OtherLibsensorsUserTests
