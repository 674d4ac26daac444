// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/ProviderLibrary.h"

#include "host/broker/Broker.h"
#include "host/broker/Request.h"
#include "host/manager/Manager.h"
#include "tests/host/manager/OddProvider.h"
#include "tests/support/ClassTable.h"
#include "tests/support/ErrorOf.h"
#include "tests/support/ProcessState.h"
#include "tests/support/TemporaryFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <dlfcn.h>

#include <memory>
#include <optional>
#include <stdexcept>
#include <utility>
#include <vector>

namespace ProviderLibraryTests {

using testing::AllOf;
using testing::HasSubstr;

const std::string oddProvider = SENSOR_PROFILE_BINARY_DIR "/lib/libOddProvider.so";
const std::string sensorProvider = SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileProvider.so";

// Keeps the odd library loaded and reads its report.
class Witness {
public:
    Witness() : library_(::dlopen(oddProvider.c_str(), RTLD_NOW | RTLD_LOCAL))
    {
        const auto report = ::dlsym(library_, "oddProviderReport");
        report_ = reinterpret_cast<Testing::OddProviderReportFunction>(report);
    }
    ~Witness() { ::dlclose(library_); }
    Witness(const Witness&) = delete;
    Witness& operator=(const Witness&) = delete;

    Testing::OddProviderReport report() const { return *report_(); }

private:
    void* library_;
    Testing::OddProviderReportFunction report_ = nullptr;
};

class ProviderLibraryTest : public testing::Test {
protected:
    Host::Broker broker_;
};

TEST_F(ProviderLibraryTest, IsInMemoryAsLongAsItsObjectLives)
{
    ASSERT_FALSE(Testing::isMapped(oddProvider));
    {
        const Host::ProviderLibrary library(broker_, oddProvider);
        EXPECT_TRUE(Testing::isMapped(oddProvider));
    }
    EXPECT_FALSE(Testing::isMapped(oddProvider));
}

TEST_F(ProviderLibraryTest, KeepsItsSymbolsToItself)
{
    const Host::ProviderLibrary library(broker_, oddProvider);
    EXPECT_EQ(::dlsym(RTLD_DEFAULT, "oddProviderReport"), nullptr);
}

TEST_F(ProviderLibraryTest, CreatesManagementInterfaces)
{
    const Witness witness;
    Host::ProviderLibrary library(broker_, oddProvider);
    EXPECT_EQ(library.createInstanceMI("Leaving").ft->ftVersion, 200);
    EXPECT_EQ(library.createAssociationMI("Leaving").ft->ftVersion, 200);
    EXPECT_EQ(witness.report().created, 2);
}

TEST_F(ProviderLibraryTest, LetsEveryManagementInterfaceCleanUpWithAContext)
{
    const Witness witness;
    {
        Host::ProviderLibrary library(broker_, oddProvider);
        library.createInstanceMI("Leaving");
        library.createAssociationMI("Leaving");
        EXPECT_EQ(witness.report().cleanedUp, 0);
    }
    EXPECT_EQ(witness.report().cleanedUp, 2);
    EXPECT_EQ(witness.report().cleanedUpWithContext, 2);
}

TEST_F(ProviderLibraryTest, StaysInMemoryWhenACleanupAsksForIt)
{
    // The copy has a name of its own, which no other test has loaded.
    const Testing::TemporaryFolder folder;
    const std::string copy = (folder.path() / "libStaying.so").string();
    std::filesystem::copy_file(oddProvider, copy);
    std::optional<Host::ProviderLibrary> library(std::in_place, broker_, copy);
    library->createInstanceMI("Leaving");
    library->createInstanceMI("Staying");
    library.reset();
    EXPECT_TRUE(Testing::isMapped(copy));
}

TEST_F(ProviderLibraryTest, ReturnsTheSensorProvidersInterface)
{
    Host::ProviderLibrary library(broker_, sensorProvider);
    EXPECT_STREQ(library.createInstanceMI("SensorProfileProvider").ft->miName,
        "instanceSensorProfileProvider");
    EXPECT_STREQ(library.createAssociationMI("SensorSystemDeviceProvider").ft->miName,
        "associationSensorSystemDeviceProvider");
}

TEST_F(ProviderLibraryTest, NamesAFileThatIsMissingOrNoLibrary)
{
    const Testing::TemporaryFolder folder;
    const std::string text = folder.write("text.so", "no library");
    EXPECT_THAT(Testing::errorOf([&] { Host::ProviderLibrary(broker_, "/no/such.so"); }),
        AllOf(HasSubstr("/no/such.so"), HasSubstr("No such file")));
    EXPECT_THAT(Testing::errorOf([&] { Host::ProviderLibrary(broker_, text); }), HasSubstr(text));
}

TEST_F(ProviderLibraryTest, NamesTheFactoryThatIsMissing)
{
    Host::ProviderLibrary library(broker_, oddProvider);
    EXPECT_EQ(Testing::errorOf([&] { library.createInstanceMI("Absent"); }),
        oddProvider + ": no factory Absent_Create_InstanceMI");
    EXPECT_EQ(Testing::errorOf([&] { library.createAssociationMI("Staying"); }),
        oddProvider + ": no factory Staying_Create_AssociationMI");
}

TEST_F(ProviderLibraryTest, SaysWhyAFactoryRefuses)
{
    Host::ProviderLibrary library(broker_, oddProvider);
    EXPECT_EQ(Testing::errorOf([&] { library.createInstanceMI("Refusing"); }),
        oddProvider + ": Refusing_Create_InstanceMI answers code 2: not on this machine");
    EXPECT_EQ(Testing::errorOf([&] { library.createInstanceMI("Empty"); }),
        oddProvider + ": Empty_Create_InstanceMI answers with nothing");
    EXPECT_EQ(Testing::errorOf([&] { library.createInstanceMI("Ancient"); }),
        oddProvider + ": Ancient_Create_InstanceMI answers with a function table of version 86");
}

// ---- Use by the manager ----

class ManagerLoadingTest : public testing::Test {
protected:
    static std::string failureOfLoading(std::vector<Host::ProviderRegistration> registrations)
    {
        const Testing::ClassTable classes;
        return Testing::errorOf([&] { Host::Manager(classes, std::move(registrations)); });
    }
};

TEST_F(ManagerLoadingTest, CreatesEveryInterfaceAtOnce)
{
    const Witness witness;
    {
        const Testing::ClassTable classes;
        const Host::Manager manager(classes, {{"BoxLink", "Leaving", oddProvider, true}});
        EXPECT_EQ(witness.report().created, 2);
    }
    EXPECT_EQ(witness.report().cleanedUp, 2);
}

TEST_F(ManagerLoadingTest, NamesTheLibraryThatCannotBeUsedAndWhy)
{
    const Testing::TemporaryFolder folder;
    const std::string text = folder.write("text.so", "no library");
    EXPECT_THAT(failureOfLoading({{"Box", "Boxes", text}}),
        AllOf(testing::StartsWith(text + ": "), HasSubstr("file too short")));
    EXPECT_EQ(failureOfLoading({{"Box", "Leaving", oddProvider}, {"Part", "Absent", oddProvider}}),
        oddProvider + ": no factory Absent_Create_InstanceMI");
    EXPECT_EQ(failureOfLoading({{"BoxLink", "Calling", oddProvider, true}}),
        oddProvider + ": no factory Calling_Create_AssociationMI");
}

TEST_F(ManagerLoadingTest, AFactoryThatCallsUpIsRefused)
{
    const Witness witness;
    Testing::ClassTable classes;
    classes.add("Box", {"Name"});
    const Host::Manager manager(classes, {{"Box", "Calling", oddProvider}});
    EXPECT_EQ(witness.report().created, 1);
    EXPECT_EQ(witness.report().upcall, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(ProviderLibraryTest, DescribesAStatusWithAndWithoutMessage)
{
    const Host::Request request(broker_);
    EXPECT_EQ(Host::describe({CMPI_RC_ERR_NOT_FOUND, nullptr}), "code 6");
    CMPIString* const message =
        broker_.handle()->eft->newString(broker_.handle(), "it is gone", nullptr);
    EXPECT_EQ(Host::describe({CMPI_RC_ERR_NOT_FOUND, message}), "code 6: it is gone");
    CMPIString handleless{};
    EXPECT_EQ(Host::describe({CMPI_RC_ERR_NOT_FOUND, &handleless}), "code 6");
}

} // namespace ProviderLibraryTests
