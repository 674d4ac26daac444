// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Loading providers ahead of requests, and factories that call up while they make an interface.

#include "tests/host/manager/ManagerTest.h"
#include "tests/host/manager/OddProvider.h"
#include "tests/support/TemporaryFolder.h"

#include <dlfcn.h>

#include <atomic>
#include <chrono>
#include <functional>
#include <future>
#include <thread>

namespace LoadingTests {

using ::testing::AllOf;
using ::testing::HasSubstr;
using Testing::refusalOf;
using ::testing::StartsWith;

const std::string oddLibrary = SENSOR_PROFILE_BINARY_DIR "/lib/libOddProvider.so";
constexpr std::chrono::seconds patience{10};

// What the factories of the provider Hooked do in a test.
std::function<void(const CMPIBroker*, const CMPIContext*, bool isOfAssociations)> factoryWork;

class LoadingTest : public ::testing::Test {
protected:
    LoadingTest() : library_(::dlopen(oddLibrary.c_str(), RTLD_NOW | RTLD_LOCAL))
    {
        function<Testing::OddProviderSetHookFunction>("setOddProviderHook")(
            [](const CMPIBroker* broker, const CMPIContext* context, bool isOfAssociations) {
                factoryWork(broker, context, isOfAssociations);
            });
    }
    ~LoadingTest() override { ::dlclose(library_); }

    int created() const
    {
        return function<Testing::OddProviderReportFunction>("oddProviderReport")()->created;
    }

    static std::string failureOfPreloading(
        const std::vector<Host::ProviderRegistration>& registrations)
    {
        const Host::ClassTable classes;
        Host::Manager manager(classes, registrations);
        return refusalOf([&] { manager.preload(); });
    }

private:
    template <typename Function>
    Function function(const char* name) const
    {
        return reinterpret_cast<Function>(::dlsym(library_, name));
    }

    void* library_;
};

TEST_F(LoadingTest, PreloadingMakesEveryInterface)
{
    const Host::ClassTable classes;
    Host::Manager manager(classes, {{"BoxLink", "Leaving", oddLibrary, true, true}});
    EXPECT_EQ(created(), 0);
    manager.preload();
    EXPECT_EQ(created(), 2);
}

TEST_F(LoadingTest, PreloadingNamesTheLibraryThatCannotBeUsedAndWhy)
{
    const Testing::TemporaryFolder folder;
    const std::string text = folder.write("text.so", "no library");
    EXPECT_THAT(failureOfPreloading({{"Box", "Boxes", text}}),
        AllOf(StartsWith("code 1: " + text + ": "), HasSubstr("file too short")));
    EXPECT_EQ(failureOfPreloading({{"Box", "Leaving", oddLibrary}, {"Part", "Absent", oddLibrary}}),
        "code 1: " + oddLibrary + ": no factory Absent_Create_InstanceMI");
    EXPECT_EQ(failureOfPreloading({{"BoxLink", "Staying", oddLibrary, false, true}}),
        "code 1: " + oddLibrary + ": no factory Staying_Create_AssociationMI");
}

// Boxes are Hooked's; Parts are served by a provider that offers nothing.
class FactoryUpcallsTest : public LoadingTest {
protected:
    FactoryUpcallsTest()
    {
        classes_.add("Box", {"Name"});
        classes_.add("Part", {"Name"});
    }

    static CMPIStatus enumerate(
        const CMPIBroker* broker, const CMPIContext* context, const char* className)
    {
        CMPIStatus status = {CMPI_RC_OK, nullptr};
        CBEnumInstanceNames(broker, context,
            CMNewObjectPath(broker, Testing::NameSpace, className, nullptr), &status);
        return status;
    }

    Host::ClassTable classes_;
    Host::Manager manager_{
        classes_, {{"Box", "Hooked", oddLibrary}, {"Part", "Leaving", oddLibrary}}};
};

TEST_F(FactoryUpcallsTest, AThreadOfAFactoryMayCallUp)
{
    std::future<CMPIrc> asked;
    factoryWork = [&](const CMPIBroker* broker, const CMPIContext* context, bool) {
        CMPIContext* const prepared = CBPrepareAttachThread(broker, context);
        asked = std::async(std::launch::async, [broker, prepared] {
            CBAttachThread(broker, prepared);
            const CMPIrc code = enumerate(broker, prepared, "Part").rc;
            CBDetachThread(broker, prepared);
            return code;
        });
        EXPECT_EQ(asked.wait_for(patience), std::future_status::ready);
    };
    manager_.preload();
    EXPECT_EQ(asked.get(), CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(created(), 2);
}

TEST_F(FactoryUpcallsTest, AFactoryThatAsksForWhatItMakesIsToldSo)
{
    int calls = 0;
    std::string answer;
    factoryWork = [&](const CMPIBroker* broker, const CMPIContext* context, bool) {
        if (++calls == 1)
            answer = Host::describe(enumerate(broker, context, "Box"));
    };
    manager_.preload();
    EXPECT_EQ(calls, 1);
    EXPECT_EQ(answer,
        "code 1: " + oddLibrary + ": Hooked_Create_InstanceMI is asked for while it is made");
}

TEST_F(FactoryUpcallsTest, FactoriesThatWaitForOneAnotherAreToldSo)
{
    const Host::Broker broker;
    Host::LoadedProviders providers(broker);
    const Host::ProviderRegistration hooked = {"Box", "Hooked", oddLibrary, true, true};
    std::atomic<int> running = 0;
    std::atomic<int> failures = 0;
    factoryWork = [&](const CMPIBroker*, const CMPIContext*, bool isOfAssociations) {
        ++running;
        for (const auto end = std::chrono::steady_clock::now() + patience;
             running < 2 && std::chrono::steady_clock::now() < end;)
            std::this_thread::yield();
        EXPECT_EQ(running, 2);
        try {
            if (running == 2 && isOfAssociations)
                providers.instanceMI(hooked);
            else if (running == 2)
                providers.associationMI(hooked);
        } catch (const std::runtime_error&) {
            ++failures;
        }
    };
    std::thread other([&] { providers.associationMI(hooked); });
    providers.instanceMI(hooked);
    other.join();
    EXPECT_EQ(failures, 1);
    EXPECT_EQ(created(), 2);
}

} // namespace LoadingTests
