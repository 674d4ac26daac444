// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Up-calls of providers for the objects of other providers.

#include "tests/host/manager/ManagerTest.h"

namespace ManagerUpcallsTests {

using ::testing::ElementsAre;
using Testing::ProviderCall;
using Testing::refusalOf;
using ::testing::StartsWith;

constexpr CMPIStatus ok = {CMPI_RC_OK, nullptr};

class ManagerUpcallsTest : public Testing::ManagerTest {
protected:
    // Returns the path that a provider gets.
    CMPIObjectPath* target(const char* className) const
    {
        return CMNewObjectPath(broker(), Testing::testNameSpace, className, nullptr);
    }

    // Delivers all objects that an up-call returned.
    static CMPIStatus handOver(
        const ProviderCall& call, const CMPIEnumeration* found, const CMPIStatus& status)
    {
        if (found == nullptr)
            return status;
        while (CMHasNext(found, nullptr)) {
            const CMPIData data = CMGetNext(found, nullptr);
            if (data.type == CMPI_ref)
                CMReturnObjectPath(call.result, data.value.ref);
            else
                CMReturnInstance(call.result, data.value.inst);
        }
        return ok;
    }
};

TEST_F(ManagerUpcallsTest, WhatAProviderFindsCanBeHandedOver)
{
    script("Boxes", [this](const ProviderCall& call) {
        CMPIStatus status = ok;
        const CMPIEnumeration* const found =
            CBEnumInstanceNames(broker(), call.context, target("Part"), &status);
        return handOver(call, found, status);
    });
    const auto found = manager_.enumerateInstanceNames(context(), path("Box"));
    EXPECT_THAT(delivered(found), ElementsAre("Part", "SpecialPart"));
    EXPECT_THAT(
        calls_, ElementsAre("Boxes enumerateInstanceNames Box", "Parts enumerateInstanceNames Part",
                    "SpecialParts enumerateInstanceNames SpecialPart"));
}

TEST_F(ManagerUpcallsTest, InstancesAreFoundToo)
{
    script("Boxes", [this](const ProviderCall& call) {
        CMPIStatus status = ok;
        const CMPIEnumeration* const found =
            CBEnumInstances(broker(), call.context, target("Part"), nullptr, &status);
        return handOver(call, found, status);
    });
    const auto found = manager_.enumerateInstances(context(), path("Box"), nullptr);
    EXPECT_THAT(delivered(found), ElementsAre("Part", "SpecialPart"));
}

TEST_F(ManagerUpcallsTest, TheContextIsTheCallersAllTheWayDown)
{
    const CMPIContext* seen = nullptr;
    script("Boxes", [this](const ProviderCall& call) {
        CBEnumInstanceNames(broker(), call.context, target("SpecialPart"), nullptr);
        return ok;
    });
    script("SpecialParts", [&](const ProviderCall& call) {
        seen = call.context;
        return ok;
    });
    manager_.enumerateInstanceNames(context(), path("Box"));
    EXPECT_EQ(seen, context().handle());
}

TEST_F(ManagerUpcallsTest, AnErrorReachesTheCallerWithItsMessage)
{
    script("SpecialParts",
        [&](const ProviderCall&) { return failure(CMPI_RC_ERR_ACCESS_DENIED, "not for you"); });
    script("Boxes", [this](const ProviderCall& call) {
        CMPIStatus status = ok;
        EXPECT_EQ(CBEnumInstances(broker(), call.context, target("SpecialPart"), nullptr, &status),
            nullptr);
        return status;
    });
    EXPECT_EQ(refusalOf([&] { manager_.getInstance(context(), path("Box"), nullptr); }),
        "code 2: not for you");
}

TEST_F(ManagerUpcallsTest, UnknownAndUnservedClassesAreDistinguished)
{
    script("Boxes", [this](const ProviderCall& call) {
        CMPIStatus status = ok;
        CBEnumInstances(broker(), call.context, target("Unheard"), nullptr, &status);
        EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_CLASS);
        CBEnumInstances(broker(), call.context, target("Idle"), nullptr, &status);
        EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
        return answer(call);
    });
    manager_.getInstance(context(), path("Box"), nullptr);
}

TEST_F(ManagerUpcallsTest, ACircleEndsInAnError)
{
    script("Boxes", [this](const ProviderCall& call) {
        CMPIStatus status = ok;
        const CMPIEnumeration* const found =
            CBEnumInstances(broker(), call.context, target("SpecialPart"), nullptr, &status);
        return handOver(call, found, status);
    });
    script("SpecialParts", [this](const ProviderCall& call) {
        CMPIStatus status = ok;
        const CMPIEnumeration* const found =
            CBEnumInstances(broker(), call.context, target("Box"), nullptr, &status);
        return handOver(call, found, status);
    });
    for (int time = 0; time < 2; ++time) {
        calls_.clear();
        EXPECT_EQ(refusalOf([&] { manager_.enumerateInstances(context(), path("Box"), nullptr); }),
            "code 1: Boxes is not asked: more than 10 provider calls stand in one another");
        EXPECT_EQ(calls_.size(), 10U);
    }
}

TEST_F(ManagerUpcallsTest, WithoutARequestOnTheThreadThereIsNoAnswer)
{
    Host::Context& borrowed = request_->context();
    std::thread([&] {
        CMPIStatus status = ok;
        EXPECT_EQ(
            CBEnumInstances(broker(), borrowed.handle(), path("Box").handle(), nullptr, &status),
            nullptr);
        EXPECT_THAT(status.rc, testing::Ne(CMPI_RC_OK));
    }).join();
}

} // namespace ManagerUpcallsTests
