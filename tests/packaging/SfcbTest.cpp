// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Tests of registering in sfcb.

#include "tests/packaging/SfcbTest.h"
#include "tests/support/Requirement.h"

#include <unistd.h>

namespace SfcbTests {

using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
namespace fs = std::filesystem;

TEST_F(SfcbTest, StagesTheFilesAndBuildsTheRepository)
{
    EXPECT_THAT(mustRun({"register"}), HasSubstr("sfcb must be restarted"));
    EXPECT_THAT(steps(), ElementsAre(stageStep(), profileStep(), buildStep_));
    EXPECT_EQ(stage(), staged("root/cimv2"));
    EXPECT_EQ(stagedRegistration(), contentOf(shared("registration/sensor-profile.reg")));
    EXPECT_THAT(
        links(), ElementsAre("libSensorProfileComputerSystem.so", "libSensorProfileProvider.so"));
}

// Somebody staged classes that the CIM schema has, too.
TEST_F(SfcbTest, ChangesNothingWhenTheRepositoryCannotBeBuilt)
{
    for (const std::string before : {"nothing", "register"}) {
        if (before == "register")
            mustRun({before});
        fs::create_directories(path("stage/mofs/root/cimv2"));
        folder_.write("stage/mofs/root/cimv2/10-cim.mof", "class CIM_ManagedElement {\n");
        for (const char* const action : {"register", "remove"}) {
            SCOPED_TRACE(before + ", then " + action);
            expectRefusalWithoutChange(
                action, "error in " + path("stage/mofs/root/cimv2/10-cim.mof"));
        }
        fs::remove(path("stage/mofs/root/cimv2/10-cim.mof"));
    }
    EXPECT_THAT(repository(), HasSubstr("ZUMLO_NumericSensor"));
    mustRun({"remove"});
    EXPECT_EQ(repository(), "");
}

TEST_F(SfcbTest, ChangesNothingWithoutTheCimSchema)
{
    fs::remove(path("CIM/CIM_Schema.mof"));
    expectRefusalWithoutChange("register", "sfcbrepos failed with exit code 1");
}

TEST_F(SfcbTest, RepeatingDoesTheSameAgain)
{
    mustRun({"register"});
    calls();
    mustRun({"register"});
    EXPECT_THAT(steps(), ElementsAre(stageStep(), profileStep(), buildStep_));
    EXPECT_EQ(stage(), staged("root/cimv2"));
    EXPECT_EQ(links().size(), 2U);
}

TEST_F(SfcbTest, RemovesWhatWasStaged)
{
    mustRun({"register"});
    calls();
    folder_.write("stage/regs/other.reg", "somebody else's");
    EXPECT_THAT(mustRun({"remove"}), HasSubstr("Removed. sfcb must be restarted"));
    EXPECT_THAT(steps(), ElementsAre(buildStep_));
    EXPECT_THAT(stage(), ElementsAre("regs/other.reg"));
    EXPECT_THAT(links(), IsEmpty());
    EXPECT_THAT(mustRun({"remove"}),
        AllOf(HasSubstr("Nothing of this product was registered."), Not(HasSubstr("Removed"))));
    EXPECT_THAT(stage(), ElementsAre("regs/other.reg"));
}

TEST_F(SfcbTest, RemovesLinksThatAreLeftOfIt)
{
    mustRun({"register"});
    fs::remove_all(path("stage/regs"));
    fs::remove_all(path("stage/mofs"));
    EXPECT_THAT(mustRun({"remove"}), HasSubstr("Removed."));
    EXPECT_THAT(links(), IsEmpty());
}

// An upgrade of the package made the link in the folder of the libraries.
TEST_F(SfcbTest, RemovesTheLinkOfTheLibrarysFormerName)
{
    const std::string former = library("libComputerSystemProvider.so");
    for (const std::string action : {"register", "remove"}) {
        fs::create_symlink(systemLibrary_, former);
        mustRun({action, "--provider-folder", library()});
        EXPECT_FALSE(fs::exists(fs::symlink_status(former))) << action;
        fs::remove(former);
    }
    EXPECT_THAT(filesBelow(library()), ElementsAre(systemLibrary_, sensorLibrary_));
}

// The command runs as a user to whom permissions apply: root without the capabilities to override
// them.
TEST_F(SfcbTest, RefusesAStageThatCannotBeLookedInto)
{
    mustRun({"register"});
    for (const char* const name : {"stage/regs", "stage/mofs/root", "stage"}) {
        calls();
        fs::permissions(path(name), fs::perms::none);
        Lines words = {program_, "remove", "--provider-folder", path("providers"),
            "--staging-folder", path("stage")};
        if (::geteuid() == 0)
            words.insert(words.begin(),
                {"/usr/bin/setpriv", "--bounding-set", "-dac_override,-dac_read_search"});
        const Ended ended = runWords(words);
        fs::permissions(path(name), fs::perms::owner_all);
        EXPECT_EQ(ended.code, 1);
        EXPECT_THAT(ended.err, HasSubstr(path(name) + " cannot be read\nNothing was changed."));
        EXPECT_THAT(calls(), IsEmpty());
        EXPECT_EQ(links().size(), 2U);
    }
}

TEST_F(SfcbTest, RemovingNeedsTheStagingFolder)
{
    if (fs::exists("/var/lib/sfcb/stage"))
        return cannotRun("this machine has the folder of sfcb");
    const Ended ended = runAsTyped({"remove", "--dry-run"});
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err, HasSubstr("/var/lib/sfcb/stage is no folder: --staging-folder"));
    EXPECT_THAT(calls(), IsEmpty());
}

TEST_F(SfcbTest, RegistersWithoutTheComputerSystem)
{
    mustRun({"register"});
    mustRun({"register", "--without-computer-system"});
    Lines files = staged("root/cimv2");
    std::erase(files, std::string("mofs/root/cimv2/") + computerSystem_);
    EXPECT_EQ(stage(), files);
    EXPECT_THAT(contentOf(stagedMof("root/cimv2/sensor-profile.mof")),
        Not(HasSubstr("class ZUMLO_ComputerSystem")));
    const Lines shipped = linesOf(contentOf(shared("registration/sensor-profile.reg")));
    EXPECT_EQ(linesOf(stagedRegistration()),
        Lines(shipped.begin(), shipped.end() - 6)); // without the block of the computer system
    EXPECT_EQ(links().size(), 2U);
}

TEST_F(SfcbTest, RegisteringInAnotherNamespaceMovesTheClasses)
{
    mustRun({"register"});
    folder_.write("stage/mofs/root/cimv2/other.mof", "somebody else's");
    calls();
    mustRun({"register", "--namespace", "root/sensors"});
    EXPECT_THAT(steps(), ElementsAre(stageStep("root/sensors", "sensor-profile.reg"),
                             profileStep("sensor-profile.reg"), buildStep_));
    Lines files = staged("root/sensors");
    files.emplace_back("mofs/root/cimv2/other.mof");
    EXPECT_THAT(stage(), testing::UnorderedElementsAreArray(files));
    EXPECT_EQ(stagedRegistration(), replaced(contentOf(shared("registration/sensor-profile.reg")),
                                        "root/cimv2", "root/sensors"));
}

TEST_F(SfcbTest, RemovingFromANamespaceLeavesTheRegistrationOfAnother)
{
    mustRun({"register", "--namespace", "root/a"});
    mustRun({"register", "--namespace", "root/b"});
    const Lines before = stage();
    const std::string registration = stagedRegistration();
    calls();
    EXPECT_THAT(mustRun({"remove", "--namespace", "root/a"}),
        AllOf(HasSubstr("The registration stays: it is for root/b."),
            HasSubstr("Nothing of this product is registered in root/a; nothing was changed.")));
    EXPECT_THAT(calls(), IsEmpty());
    EXPECT_EQ(stage(), before);
    EXPECT_EQ(stagedRegistration(), registration);
    EXPECT_EQ(links().size(), 2U);

    // Classes in the namespace without a registration are removed.
    fs::create_directories(path("stage/mofs/root/a"));
    folder_.write("stage/mofs/root/a/sensor-profile.mof", "");
    mustRun({"remove", "--namespace", "root/a"});
    EXPECT_THAT(steps(), ElementsAre(buildStep_));
    EXPECT_EQ(stage(), before);
    EXPECT_EQ(links().size(), 2U);

    mustRun({"remove", "--namespace", "root/b"});
    EXPECT_THAT(stage(), IsEmpty());
    EXPECT_THAT(links(), IsEmpty());
}

TEST_F(SfcbTest, RemovingWithoutANamespaceRemovesFromWhicheverItIs)
{
    mustRun({"register", "--namespace", "root/b"});
    mustRun({"remove"});
    EXPECT_THAT(stage(), IsEmpty());
    EXPECT_THAT(links(), IsEmpty());
}

TEST_F(SfcbTest, DryRunPrintsTheStepsAndTakesNone)
{
    const Lines planned = linesOf(mustRun({"register", "--dry-run"}));
    EXPECT_EQ(planned.at(2), stageStep());
    EXPECT_EQ(planned.at(4), buildStep_);
    EXPECT_THAT(calls(), IsEmpty());
    EXPECT_THAT(stage(), IsEmpty());
    EXPECT_THAT(links(), IsEmpty());
    mustRun({"register"});
    EXPECT_THAT(mustRun({"remove", "--dry-run"}), Not(HasSubstr("Removed")));
    EXPECT_EQ(stage(), staged("root/cimv2"));
    EXPECT_EQ(links().size(), 2U);
}

// Typing the printed commands has the effect of the run itself.
TEST_F(SfcbTest, DryRunCanBeFollowed)
{
    const Lines options = {"register", "--namespace", "root/s", "--without-computer-system"};
    Lines planning = options;
    planning.emplace_back("--dry-run");
    std::string script = mustRun(planning);
    script = script.substr(0, script.find("This was a dry run"));
    EXPECT_THAT(script, Not(HasSubstr("/tmp.")));
    EXPECT_THAT(script, testing::StartsWith("sed -e 's|root/cimv2|root/s|' -e '"));
    fs::create_directory(path("own"));
    const Ended followed = runWords({"/bin/sh", "-ec", "cd '" + path("own") + "'\n" + script});
    ASSERT_EQ(followed.code, 0) << followed.err;
    const Lines files = stage();
    const std::string registration = stagedRegistration();
    const Lines linked = links();
    EXPECT_EQ(files.size(), 5U);

    mustRun({"remove"});
    mustRun(options);
    EXPECT_EQ(stage(), files);
    EXPECT_EQ(stagedRegistration(), registration);
    EXPECT_EQ(links(), linked);
}

} // namespace SfcbTests
