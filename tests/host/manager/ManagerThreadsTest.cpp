// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests on many threads.

#include "tests/host/manager/ManagerTest.h"

#include <atomic>
#include <thread>

namespace ManagerThreadsTests {

using Testing::ProviderCall;

constexpr int threadCount = 8;
constexpr CMPIStatus ok = {CMPI_RC_OK, nullptr};

void onThreads(const std::function<void()>& work)
{
    std::vector<std::thread> threads;
    for (int i = 0; i < threadCount; ++i)
        threads.emplace_back(work);
    for (std::thread& thread : threads)
        thread.join();
}

// A fixture of its own, since the providers of the others record their calls on one thread.
class ManagerThreadsTest : public Testing::ManagerTest {
protected:
    ManagerThreadsTest()
    {
        request_.reset();
        providers_["Parts"].handle([this](const ProviderCall& call) { return answer(call); });
        providers_["SpecialParts"].handle(
            [this](const ProviderCall& call) { return answer(call); });
        providers_["Boxes"].handle([this](const ProviderCall& call) {
            CMPIStatus status = ok;
            const CMPIObjectPath* const target =
                CMNewObjectPath(broker(), Testing::testNameSpace, "Part", nullptr);
            const CMPIEnumeration* const found =
                CBEnumInstances(broker(), call.context, target, nullptr, &status);
            while (found != nullptr && CMHasNext(found, nullptr))
                CMReturnInstance(call.result, CMGetNext(found, nullptr).value.inst);
            return status;
        });
        providers_["BoxLinks"].handle([this](const ProviderCall& call) { return answer(call); });
        providers_["ThingLinks"].handle(
            [this](const ProviderCall&) { return failure(CMPI_RC_ERR_NOT_SUPPORTED, "no"); });
    }
};

TEST_F(ManagerThreadsTest, EveryRequestGetsItsWholeAnswer)
{
    std::atomic<int> wrong = 0;
    onThreads([&] {
        for (int i = 0; i < 50; ++i) {
            Host::Request request(manager_.broker());
            const auto found = manager_.enumerateInstances(
                request.context(), request.makePath(Testing::testNameSpace, "Thing"), nullptr);
            const auto names = manager_.associatorNames(
                request.context(), request.makePath(Testing::testNameSpace, "Box"), {});
            if (found.instances().size() != 4 || names.paths().size() != 1)
                ++wrong;
        }
    });
    EXPECT_EQ(wrong, 0);
}

} // namespace ManagerThreadsTests
