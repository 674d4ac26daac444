// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Operations on the instances of a class.

#include "tests/host/manager/ManagerTest.h"

namespace ManagerInstanceTests {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using Testing::ProviderCall;
using Testing::refusalOf;

constexpr CMPIStatus ok = {CMPI_RC_OK, nullptr};

using ManagerInstanceTest = Testing::ManagerTest;

TEST_F(ManagerInstanceTest, AClassGoesToItsProvider)
{
    EXPECT_EQ(manager_.enumerateInstances(context(), path("Box"), nullptr).instances().size(), 1U);
    EXPECT_EQ(manager_.enumerateInstanceNames(context(), path("Box")).paths().size(), 1U);
    EXPECT_THAT(
        calls_, ElementsAre("Boxes enumerateInstances Box", "Boxes enumerateInstanceNames Box"));
}

TEST_F(ManagerInstanceTest, AProviderGetsTheNameOfItsClassAsItIsRegistered)
{
    manager_.enumerateInstances(context(), path("bOX"), nullptr);
    EXPECT_THAT(calls_, ElementsAre("Boxes enumerateInstances Box"));
}

TEST_F(ManagerInstanceTest, ASuperclassReachesEveryServedClassBelowIt)
{
    const auto found = manager_.enumerateInstances(context(), path("Thing"), nullptr);
    EXPECT_THAT(delivered(found), ElementsAre("Box", "Part", "SpecialPart"));
}

TEST_F(ManagerInstanceTest, AServedClassBringsItsSubclassesAlong)
{
    const auto found = manager_.enumerateInstanceNames(context(), path("Part"));
    EXPECT_THAT(delivered(found), ElementsAre("Part", "SpecialPart"));
}

TEST_F(ManagerInstanceTest, AnUnknownClassIsInvalid)
{
    const std::string expected = "code 5: there is no class Unheard in root/cimv2";
    EXPECT_EQ(refusalOf([&] { manager_.enumerateInstances(context(), path("Unheard"), nullptr); }),
        expected);
    EXPECT_EQ(
        refusalOf([&] { manager_.getInstance(context(), path("Unheard"), nullptr); }), expected);
}

TEST_F(ManagerInstanceTest, AClassWithoutProviderIsNotSupported)
{
    const std::string expected = "code 7: no provider serves the class Idle";
    EXPECT_EQ(
        refusalOf([&] { manager_.enumerateInstanceNames(context(), path("Idle")); }), expected);
}

TEST_F(ManagerInstanceTest, OfAClassWithoutProviderNothingIsFound)
{
    EXPECT_EQ(refusalOf([&] { manager_.getInstance(context(), path("Idle"), nullptr); }),
        "code 6: there is no root/cimv2:Idle");
}

TEST_F(ManagerInstanceTest, AnInstanceIsOfItsOwnClassOnly)
{
    EXPECT_EQ(manager_.getInstance(context(), path("Part"), nullptr).className(), "Part");
    EXPECT_THAT(calls_, ElementsAre("Parts getInstance Part"));
    EXPECT_EQ(refusalOf([&] { manager_.getInstance(context(), path("Thing"), nullptr); }),
        "code 6: there is no root/cimv2:Thing");
}

TEST_F(ManagerInstanceTest, AnAnswerWithoutInstanceIsNotFound)
{
    script("Boxes", [](const ProviderCall&) { return ok; });
    EXPECT_EQ(refusalOf([&] { manager_.getInstance(context(), path("Box"), nullptr); }),
        "code 6: there is no root/cimv2:Box");
}

TEST_F(ManagerInstanceTest, TheArgumentsArriveAsTheyAre)
{
    const char* properties[] = {"Name", nullptr};
    script("Boxes", [&](const ProviderCall& call) {
        EXPECT_EQ(call.context, context().handle());
        EXPECT_EQ(call.properties, properties);
        EXPECT_EQ(Host::ObjectPath::of(call.path)->key("Name")->text(), "a box");
        return answer(call);
    });
    Host::ObjectPath& box = path("Box");
    box.addKey("Name", Host::Value::text(request_->arena(), "a box"));
    manager_.getInstance(context(), box, properties);
}

TEST_F(ManagerInstanceTest, AProviderMayChangeItsPathWithoutChangingTheCallers)
{
    script("Boxes", [&](const ProviderCall& call) {
        CMSetNameSpace(call.path, "elsewhere");
        return answer(call);
    });
    const Host::ObjectPath& box = path("Box");
    manager_.getInstance(context(), box, nullptr);
    EXPECT_EQ(box.nameSpace(), Testing::testNameSpace);
}

TEST_F(ManagerInstanceTest, AProvidersErrorIsPassedOn)
{
    script("Boxes", [&](const ProviderCall& call) {
        answer(call);
        return failure(CMPI_RC_ERR_ACCESS_DENIED, "not today");
    });
    EXPECT_EQ(refusalOf([&] { manager_.enumerateInstances(context(), path("Box"), nullptr); }),
        "code 2: not today");
}

TEST_F(ManagerInstanceTest, AnErrorWithoutMessageNamesTheProvider)
{
    script("Boxes", [](const ProviderCall&) { return CMPIStatus{CMPI_RC_ERR_FAILED, nullptr}; });
    EXPECT_EQ(refusalOf([&] { manager_.getInstance(context(), path("Box"), nullptr); }),
        "code 1: Boxes answers code 1");
}

TEST_F(ManagerInstanceTest, WhatAProviderDoesNotSupportIsSaid)
{
    script("Boxes", [](const ProviderCall&) {
        return CMPIStatus{CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
    });
    const auto what = [](const char* operation) {
        return std::string("code 7: Boxes does not support ") + operation + " of Box";
    };
    EXPECT_EQ(refusalOf([&] { manager_.getInstance(context(), path("Box"), nullptr); }),
        what("getting instances"));
    EXPECT_EQ(refusalOf([&] { manager_.enumerateInstances(context(), path("Box"), nullptr); }),
        what("enumerating instances"));
    EXPECT_EQ(refusalOf([&] { manager_.enumerateInstanceNames(context(), path("Box")); }),
        what("enumerating instance names"));
}

TEST_F(ManagerInstanceTest, AnExceptionOfAProviderIsAFailure)
{
    script("Boxes",
        [](const ProviderCall&) -> CMPIStatus { throw std::runtime_error("out of boxes"); });
    EXPECT_EQ(refusalOf([&] { manager_.getInstance(context(), path("Box"), nullptr); }),
        "code 1: Boxes: out of boxes");
}

TEST_F(ManagerInstanceTest, WhatIsNoObjectIsRefusedAndCounted)
{
    script("Boxes", [](const ProviderCall& call) {
        EXPECT_NE(CMReturnInstance(call.result, nullptr).rc, CMPI_RC_OK);
        return ok;
    });
    const auto found = manager_.enumerateInstances(context(), path("Box"), nullptr);
    EXPECT_EQ(found.refused(), 1U);
}

// ---- Several providers ----

TEST_F(ManagerInstanceTest, WhatOneProviderFailsToAnswerTakesNothingFromTheOthers)
{
    script("Boxes", [&](const ProviderCall& call) {
        answer(call);
        return failure(CMPI_RC_ERR_FAILED, "broken");
    });
    const auto found = manager_.enumerateInstances(context(), path("Thing"), nullptr);
    EXPECT_THAT(delivered(found), ElementsAre("Part", "SpecialPart"));
}

TEST_F(ManagerInstanceTest, WhereNothingAtAllIsFoundTheFirstFailureIsTheAnswer)
{
    script("Boxes", [](const ProviderCall&) { return ok; });
    script("Parts", [&](const ProviderCall&) { return failure(CMPI_RC_ERR_FAILED, "first"); });
    script(
        "SpecialParts", [&](const ProviderCall&) { return failure(CMPI_RC_ERR_FAILED, "second"); });
    EXPECT_EQ(refusalOf([&] { manager_.enumerateInstances(context(), path("Thing"), nullptr); }),
        "code 1: first");
}

} // namespace ManagerInstanceTests
