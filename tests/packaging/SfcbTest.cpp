// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Tests of registering in sfcb.

#include "tests/packaging/RegisterTest.h"
#include "tests/support/Requirement.h"

#include <unistd.h>

#include <tuple>

namespace SfcbTests {

using testing::AllOf;
using testing::AnyOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using namespace Testing;
namespace fs = std::filesystem;

class SfcbTest : public RegisterTest {
protected:
    SfcbTest() : RegisterTest({"sfcbstage", "sfcbrepos"}) {}

    // Returns the staged files except sfcb's own.
    Lines stage() const
    {
        Lines files = filesBelow(path("stage"));
        std::erase(files, "default.reg");
        return files;
    }

    // Returns the calls that change the staging folder; others work on a copy of it.
    Lines steps() const
    {
        Lines all = calls();
        std::erase_if(all, [this](const std::string& call) {
            return call.find(" -s " + path("stage") + " ") == call.npos;
        });
        return all;
    }

    std::string repository() const
    {
        return contentOf(path("registration/repository/root/cimv2/classes"));
    }

    void expectRefusalWithoutChange(const std::string& action, const std::string& reason) const
    {
        const auto before = std::tuple(filesBelow(path("stage")), links(), repository());
        const Ended ended = runRegister({action});
        EXPECT_EQ(ended.code, 1);
        EXPECT_THAT(
            ended.err, AllOf(HasSubstr(reason), testing::EndsWith("Nothing was changed.\n")));
        EXPECT_EQ(std::tuple(filesBelow(path("stage")), links(), repository()), before);
    }

    std::string stagedRegistration() const
    {
        return contentOf(path("stage/regs/sensor-profile.reg"));
    }

    static std::string stepOf(const std::string& stage, const std::string& nameSpace,
        const std::string& registration, const Lines& files)
    {
        std::string step = "sfcbstage -s " + stage + " -n " + nameSpace + " -r " + registration;
        for (const std::string& file : files)
            step += " " + shared(file);
        return step;
    }

    // Returns the step that stages the classes of the sensors' namespace.
    std::string stageStep(const std::string& nameSpace = "root/cimv2",
        const std::string& registration = shared("registration/sensor-profile.reg")) const
    {
        return stepOf(
            path("stage"), nameSpace, registration, {computerSystem_, sensors_, conformance_});
    }

    // Returns the step that stages those of the profile's registration.
    std::string profileStep(
        const std::string& registration = shared("registration/sensor-profile.reg")) const
    {
        return stepOf(path("stage"), "root/interop", registration, {conformance_, profile_});
    }

    // Returns the files that a registration in the namespace stages.
    static Lines staged(const std::string& nameSpace)
    {
        Lines files = {"mofs/" + nameSpace + "/" + computerSystem_,
            "mofs/" + nameSpace + "/" + conformance_, "mofs/" + nameSpace + "/" + sensors_,
            std::string("mofs/root/interop/") + conformance_,
            std::string("mofs/root/interop/") + profile_, "regs/sensor-profile.reg"};
        std::sort(files.begin(), files.end());
        return files;
    }

    std::string stagedMof(const std::string& name) const { return path("stage/mofs/" + name); }

    static constexpr const char* computerSystem_ = "sensor-profile-computer-system.mof";
    static constexpr const char* sensors_ = "sensor-profile.mof";
    static constexpr const char* conformance_ = "sensor-profile-conformance.mof";
    static constexpr const char* profile_ = "sensor-profile-registered-profile.mof";
    const std::string buildStep_ = "sfcbrepos -s " + path("stage") + " -f";
};

TEST_F(SfcbTest, StagesTheFilesAndBuildsTheRepository)
{
    EXPECT_THAT(mustRun({"register"}), HasSubstr("sfcb must be restarted"));
    EXPECT_THAT(steps(), ElementsAre(stageStep(), profileStep(), buildStep_));
    EXPECT_EQ(stage(), staged("root/cimv2"));
    EXPECT_EQ(stagedRegistration(), contentOf(shared("registration/sensor-profile.reg")));
    EXPECT_THAT(
        links(), ElementsAre("libSensorProfileComputerSystem.so", "libSensorProfileProvider.so"));
}

class ConfiguredSfcbTest : public SfcbTest {
protected:
    ConfiguredSfcbTest()
    {
        for (const char* const name : {"own/stage", "own/lib", "own/lib/cmpi", "etc/sfcb"})
            fs::create_directories(path(name));
        folder_.write("own/stage/default.reg", "");
    }

    // Writes a configuration with a comment, blanks and a provider folder that does not exist.
    void configure(const std::string& file, const std::string& registration) const
    {
        folder_.write(file, "##  Locations\n#registrationDir: /none\nregistrationDir: " +
                                registration + " \n  providerDirs:\t" + path("own/lib") + " " +
                                path("own/lib/cmpi") + " /no/such\nhttpPort: 5988\n");
    }

    const std::string build_ =
        "sfcbrepos -s " + path("own/stage") + " -r " + path("own/registration") + " -f";
};

TEST_F(ConfiguredSfcbTest, HasTheFoldersOfTheConfigurationBesideItsProgram)
{
    configure("etc/sfcb/sfcb.cfg", path("own/registration"));
    for (int time = 0; time < 2; ++time) {
        EXPECT_EQ(runAsTyped({"register"}).code, 0);
        EXPECT_THAT(calls(), AllOf(testing::SizeIs(6), testing::Contains(build_)));
        EXPECT_THAT(
            filesBelow(path("own/lib")), ElementsAre("cmpi/libSensorProfileComputerSystem.so",
                                             "cmpi/libSensorProfileProvider.so"));
        EXPECT_THAT(filesBelow(path("own/registration")),
            ElementsAre("providerRegister", "repository/root/cimv2/classes",
                "repository/root/interop/classes"));
    }
    EXPECT_EQ(runAsTyped({"remove"}).code, 0);
    EXPECT_THAT(filesBelow(path("own/lib")), IsEmpty());
    EXPECT_THAT(filesBelow(path("own/stage")), ElementsAre("default.reg"));
}

TEST_F(ConfiguredSfcbTest, TakesTheConfigurationThatIsNamed)
{
    configure("etc/sfcb/sfcb.cfg", "/no/such");
    configure("other.cfg", path("own/registration"));
    EXPECT_THAT(plan({"register", "--configuration", path("other.cfg")}), HasSubstr(build_ + "\n"));
    failAt(4);
    const Ended ended = runAsTyped({"register", "--configuration=" + path("other.cfg")});
    failNoMore();
    EXPECT_THAT(ended.err, HasSubstr("To undo it: " + program_ +
                                     " remove --object-manager sfcb "
                                     "--namespace root/cimv2 --configuration " +
                                     path("other.cfg") + "\n"));
}

TEST_F(ConfiguredSfcbTest, TakesTheFoldersThatAreNamed)
{
    configure("etc/sfcb/sfcb.cfg", path("own/registration"));
    const std::string planned = plan(
        {"register", "--provider-folder", path("providers"), "--staging-folder", path("stage")});
    EXPECT_THAT(planned, AllOf(HasSubstr(linkStep(sensorLibrary_)),
                             HasSubstr("sfcbrepos -s " + path("stage") + " -r " +
                                       path("own/registration") + " -f\n")));
}

TEST_F(ConfiguredSfcbTest, ChangesNothingInAStagingFolderThatIsALink)
{
    configure("etc/sfcb/sfcb.cfg", path("own/registration"));
    fs::remove_all(path("own/stage"));
    fs::create_directory_symlink(path("stage"), path("own/stage"));
    folder_.write("stage/other.mof", "");
    fs::remove(path("CIM/CIM_Schema.mof"));
    EXPECT_EQ(runAsTyped({"register"}).code, 1);
    EXPECT_THAT(stage(), ElementsAre("other.mof"));
}

TEST_F(ConfiguredSfcbTest, LinksNothingWhereItLooksInTheFolderOfTheLibraries)
{
    folder_.write("etc/sfcb/sfcb.cfg", "providerDirs: " + library() + " " + path("own/lib") + "\n");
    EXPECT_THAT(plan({"register", "--staging-folder", path("stage")}),
        Not(AnyOf(HasSubstr("ln -s"), HasSubstr("must look"))));
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

class EveryFirstStepOfSfcbTest : public EveryStepOf<SfcbTest> {};

TEST_P(EveryFirstStepOfSfcbTest, CanFailAndBeUndone)
{
    const std::string message = failing(3, {"register"},
        {linkStep(sensorLibrary_), linkStep(systemLibrary_), stageStep(), profileStep(),
            buildStep_});
    mustRunAdvice(message, "To undo it: ", "\n");
    EXPECT_THAT(links(), IsEmpty());
    EXPECT_THAT(stage(), IsEmpty());
    mustRun({"register"});
    EXPECT_EQ(stage(), staged("root/cimv2"));
}

INSTANTIATE_TEST_SUITE_P(Steps, EveryFirstStepOfSfcbTest, testing::Range<std::size_t>(0, 5));

class EveryMovingStepOfSfcbTest : public EveryStepOf<SfcbTest> {};

TEST_P(EveryMovingStepOfSfcbTest, CanFailAndLeadBack)
{
    mustRun({"register", "--without-computer-system"});
    const Lines files = stage();
    const std::string registration = stagedRegistration();
    const std::string message = failing(4, {"register", "--namespace", "root/new"},
        {stageStep("root/new", "sensor-profile.reg"), profileStep("sensor-profile.reg"),
            "rm " + stagedMof("root/cimv2/") + conformance_ + " " + stagedMof("root/cimv2/") +
                sensors_,
            buildStep_});
    EXPECT_THAT(message, Not(HasSubstr(" remove ")));
    mustRunAdvice(message, "To undo it: ", "\n");
    EXPECT_EQ(stage(), files);
    EXPECT_EQ(stagedRegistration(), registration);
    EXPECT_EQ(links().size(), 2U);
}

INSTANTIATE_TEST_SUITE_P(Steps, EveryMovingStepOfSfcbTest, testing::Range<std::size_t>(0, 4));

class EveryRemovalStepOfSfcbTest : public EveryStepOf<SfcbTest> {
protected:
    EveryRemovalStepOfSfcbTest() { mustRun({"register", "--namespace", "root/s"}); }

    std::string failingRemoval()
    {
        return failing(2, {"remove"},
            {"rm " + stagedMof("root/interop/") + conformance_ + " " + stagedMof("root/interop/") +
                    profile_ + " " + stagedMof("root/s/") + computerSystem_ + " " +
                    stagedMof("root/s/") + sensors_ + " " + stagedMof("root/s/") + conformance_ +
                    " " + path("stage/regs/sensor-profile.reg"),
                buildStep_, unlinkStep(sensorLibrary_), unlinkStep(systemLibrary_)});
    }
};

TEST_P(EveryRemovalStepOfSfcbTest, CanFailAndBeUndone)
{
    const Lines files = stage();
    const std::string registration = stagedRegistration();
    mustRunAdvice(failingRemoval(), "To undo it: ", "\n");
    EXPECT_EQ(stage(), files);
    EXPECT_EQ(stagedRegistration(), registration);
    EXPECT_EQ(links().size(), 2U);
}

TEST_P(EveryRemovalStepOfSfcbTest, CanFailAndBeRepeated)
{
    failingRemoval();
    mustRun({"remove"});
    EXPECT_THAT(calls(), testing::Contains(buildStep_));
    EXPECT_THAT(stage(), IsEmpty());
    EXPECT_THAT(links(), IsEmpty());
}

INSTANTIATE_TEST_SUITE_P(Steps, EveryRemovalStepOfSfcbTest, testing::Range<std::size_t>(0, 4));

} // namespace SfcbTests
