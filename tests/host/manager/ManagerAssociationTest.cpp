// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Operations along associations.

#include "tests/host/manager/ManagerTest.h"

namespace ManagerAssociationTests {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Testing::orNone;
using Testing::ProviderCall;
using Testing::refusalOf;
using ::testing::StartsWith;

using Association = Host::Manager::Association;

constexpr CMPIStatus ok = {CMPI_RC_OK, nullptr};

class ManagerAssociationTest : public Testing::ManagerTest {
protected:
    ManagerAssociationTest()
    {
        for (const char* const name : {"BoxLinks", "ThingLinks"})
            script(name, [this](const ProviderCall& call) {
                arguments_.push_back(orNone(call.associationClass) + " " +
                                     orNone(call.resultClass) + " " + orNone(call.role) + " " +
                                     orNone(call.resultRole));
                return deliver(call, "Part", "one");
            });
    }

    // Returns the calls of the association providers with their arguments.
    const std::vector<std::string>& asked(const char* source, const Association& association)
    {
        arguments_.clear();
        manager_.associatorNames(context(), path(source), association);
        return arguments_;
    }

    std::vector<std::string> arguments_;
};

TEST_F(ManagerAssociationTest, WithoutAssociationClassEachIsAskedByItsOwnName)
{
    EXPECT_THAT(asked("Box", {}), ElementsAre("BoxLink - - -", "ThingLink - - -"));
    EXPECT_EQ(manager_.associatorNames(context(), path("Box"), {}).paths().size(), 2U);
}

TEST_F(ManagerAssociationTest, ASuperclassOfAssociationsAsksEachByItsOwnName)
{
    EXPECT_THAT(asked("Box", {.associationClass = "Link"}),
        ElementsAre("BoxLink - - -", "ThingLink - - -"));
}

TEST_F(ManagerAssociationTest, ANamedAssociationClassIsAskedAlone)
{
    EXPECT_THAT(asked("Box", {.associationClass = "boxlink"}), ElementsAre("BoxLink - - -"));
}

TEST_F(ManagerAssociationTest, AnUnrelatedAssociationClassIsAnEmptyAnswer)
{
    EXPECT_THAT(asked("Box", {.associationClass = "Part"}), IsEmpty());
}

TEST_F(ManagerAssociationTest, UnknownClassesAreInvalid)
{
    EXPECT_EQ(refusalOf([&] { asked("Unheard", {}); }),
        "code 5: there is no class Unheard in root/cimv2");
    EXPECT_THAT(
        refusalOf([&] { asked("Box", {.associationClass = "Nolink"}); }), StartsWith("code 5"));
    EXPECT_THAT(refusalOf([&] { asked("Box", {.resultClass = "Nothing"}); }), StartsWith("code 5"));
}

TEST_F(ManagerAssociationTest, ASourceBelowTheReferencedClassCounts)
{
    EXPECT_THAT(asked("SpecialPart", {}), ElementsAre("BoxLink - - -", "ThingLink - - -"));
    EXPECT_THAT(asked("Idle", {}), ElementsAre("ThingLink - - -"));
}

TEST_F(ManagerAssociationTest, ASourceAboveTheReferencedClassDoesNot)
{
    EXPECT_THAT(asked("Thing", {.associationClass = "BoxLink"}), IsEmpty());
}

TEST_F(ManagerAssociationTest, RolesThatAreNotTheSourcesExcludeAnAssociation)
{
    EXPECT_THAT(asked("Box", {.associationClass = "BoxLink", .role = "whole"}),
        ElementsAre("BoxLink - whole -"));
    EXPECT_THAT(asked("Box", {.associationClass = "BoxLink", .role = "Piece"}), IsEmpty());
    EXPECT_THAT(asked("Box", {.role = "Other"}), IsEmpty());
}

TEST_F(ManagerAssociationTest, ResultRolesThatAreNotAtTheOtherEndExcludeAnAssociation)
{
    EXPECT_THAT(asked("Box", {.associationClass = "BoxLink", .resultRole = "PIECE"}),
        ElementsAre("BoxLink - - PIECE"));
    EXPECT_THAT(asked("Part", {.associationClass = "BoxLink", .resultRole = "Piece"}), IsEmpty());
    EXPECT_THAT(asked("Box", {.resultRole = "Other"}), IsEmpty());
}

TEST_F(ManagerAssociationTest, ResultClassesThatCannotBeReachedExcludeAnAssociation)
{
    EXPECT_THAT(asked("Box", {.resultClass = "Idle"}), ElementsAre("ThingLink Idle - -"));
    EXPECT_THAT(asked("Box", {.associationClass = "BoxLink", .resultClass = "SpecialPart"}),
        ElementsAre("BoxLink SpecialPart - -")); // a Part may be a SpecialPart
    EXPECT_THAT(asked("Box", {.associationClass = "BoxLink", .resultClass = "Thing"}),
        ElementsAre("BoxLink - - -")); // all objects at its ends are Things
}

TEST_F(ManagerAssociationTest, TheSourceKeepsItsKeysAndHasItsClassesRegisteredName)
{
    std::vector<std::string> seen;
    script("BoxLinks", [&](const ProviderCall& call) {
        seen.push_back(Host::ObjectPath::of(call.path)->toText());
        return ok;
    });
    Host::ObjectPath& box = path("bOx");
    box.addKey("Name", Host::Value::text(request_->arena(), "b"));
    const Association association = {.associationClass = "BoxLink"};
    manager_.associators(context(), box, association, nullptr);
    manager_.associatorNames(context(), box, association);
    manager_.references(context(), box, association, nullptr);
    manager_.referenceNames(context(), box, association);
    EXPECT_THAT(
        seen, testing::AllOf(testing::SizeIs(4), testing::Each("root/cimv2:Box.Name=\"b\"")));
}

TEST_F(ManagerAssociationTest, ResultsAreOfTheResultClassOrBelowIt)
{
    script("BoxLinks", [this](const ProviderCall& call) {
        for (const char* const each : {"Part", "SpecialPart", "Box", "Unheard"})
            deliver(call, each, "one");
        return ok;
    });
    const auto found = [&](const char* resultClass, bool asNames) {
        const Association association = {"BoxLink", resultClass, nullptr, nullptr};
        return delivered(asNames
                             ? manager_.associatorNames(context(), path("Box"), association)
                             : manager_.associators(context(), path("Box"), association, nullptr));
    };
    for (const bool asNames : {false, true}) {
        EXPECT_THAT(found("Part", asNames), ElementsAre("Part", "SpecialPart"));
        EXPECT_THAT(found("specialpart", asNames), ElementsAre("SpecialPart"));
        EXPECT_THAT(found("Thing", asNames), ElementsAre("Part", "SpecialPart", "Box"));
        EXPECT_EQ(found(nullptr, asNames).size(), 4U);
    }
}

TEST_F(ManagerAssociationTest, ReferencesGoByTheAssociationClassAsResultClass)
{
    for (const auto& [provider, className] :
        {std::pair{"BoxLinks", "BoxLink"}, std::pair{"ThingLinks", "Idle"}})
        script(provider, [this, className = className](const ProviderCall& call) {
            arguments_.push_back(orNone(call.resultClass) + " " + orNone(call.role));
            return deliver(call, className, "one");
        });
    const auto found = manager_.references(
        context(), path("Box"), {.resultClass = "Link", .role = "Whole"}, nullptr);
    EXPECT_THAT(arguments_, ElementsAre("BoxLink Whole", "ThingLink Whole"));
    EXPECT_THAT(delivered(found), ElementsAre("BoxLink")); // objects that are no Link are left out
    arguments_.clear();
    manager_.referenceNames(context(), path("Part"), {.resultClass = "BoxLink"});
    EXPECT_THAT(arguments_, ElementsAre("BoxLink -"));
    manager_.references(context(), path("Part"), {.role = "Whole"}, nullptr);
    EXPECT_THAT(arguments_, ElementsAre("BoxLink -"));
}

TEST_F(ManagerAssociationTest, AnAnswerOutlivesTheFailureOfAnotherProvider)
{
    script("BoxLinks", [&](const ProviderCall& call) {
        deliver(call, "Part", "of a failed answer");
        return failure(CMPI_RC_ERR_FAILED, "broken");
    });
    const auto found = manager_.associators(context(), path("Box"), {}, nullptr);
    ASSERT_EQ(found.instances().size(), 1U);
    EXPECT_EQ(found.instances()[0]->property("Name")->text(), "one");
}

TEST_F(ManagerAssociationTest, AFailureWithoutAnyAnswerIsPassedOn)
{
    script("ThingLinks", [](const ProviderCall&) { return ok; });
    script("BoxLinks", [&](const ProviderCall&) { return failure(CMPI_RC_ERR_FAILED, "broken"); });
    EXPECT_EQ(refusalOf([&] { manager_.references(context(), path("Box"), {}, nullptr); }),
        "code 1: broken");
}

} // namespace ManagerAssociationTests
