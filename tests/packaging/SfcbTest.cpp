// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Registering in sfcb.

#include "tests/packaging/RegisterTest.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using namespace Testing;
namespace fs = std::filesystem;

class Sfcb : public RegisterTest {
protected:
    Sfcb() : RegisterTest({"sfcbstage", "sfcbrepos"})
    {
        fs::create_directory(path("providers"));
        fs::create_directory(path("stage"));
    }

    Ended runStaged(const std::string& action, Lines more = {}) const
    {
        return runRegister(staged(action, std::move(more)));
    }

    std::string mustRunStaged(const std::string& action, Lines more = {}) const
    {
        return mustRun(staged(action, std::move(more)));
    }

    Lines links() const { return filesBelow(path("providers")); }
    Lines stage() const { return filesBelow(path("stage")); }

    const std::string stageCall_ = "sfcbstage -s " + path("stage") + " -n root/cimv2 -r " +
                                   shared("registration/sensor-profile.reg") + " " +
                                   shared("sensor-profile.mof");
    const std::string buildCall_ = "sfcbrepos -s " + path("stage") + " -f";

private:
    Lines staged(const std::string& action, Lines more) const
    {
        more.insert(more.begin(),
            {action, "--staging-folder", path("stage"), "--provider-folder", path("providers")});
        return more;
    }
};

TEST_F(Sfcb, stagesTheFilesAndBuildsTheRepository)
{
    EXPECT_THAT(mustRunStaged("register"), HasSubstr("sfcb must be restarted"));
    EXPECT_THAT(calls(), ElementsAre(stageCall_, buildCall_));
    EXPECT_THAT(
        stage(), ElementsAre("mofs/root/cimv2/sensor-profile.mof", "regs/sensor-profile.reg"));
    EXPECT_EQ(contentOf(path("stage/regs/sensor-profile.reg")),
        contentOf(shared("registration/sensor-profile.reg")));
    EXPECT_THAT(
        links(), ElementsAre("libComputerSystemProvider.so", "libSensorProfileProvider.so"));
}

TEST_F(Sfcb, namesNoFoldersThatNobodyNamed)
{
    mustRun({"register"});
    EXPECT_THAT(calls(),
        ElementsAre("sfcbstage -n root/cimv2 -r " + shared("registration/sensor-profile.reg") +
                        " " + shared("sensor-profile.mof"),
            "sfcbrepos -f"));
}

TEST_F(Sfcb, repeatingDoesTheSameAgain)
{
    mustRunStaged("register");
    calls();
    mustRunStaged("register");
    EXPECT_THAT(calls(), ElementsAre(stageCall_, buildCall_));
    EXPECT_EQ(stage().size(), 2U);
    EXPECT_EQ(links().size(), 2U);
}

TEST_F(Sfcb, removesWhatWasStaged)
{
    mustRunStaged("register");
    calls();
    fs::create_directories(path("stage/regs"));
    folder_.write("stage/regs/other.reg", "somebody else's");
    EXPECT_THAT(mustRunStaged("remove"), HasSubstr("Removed. sfcb must be restarted"));
    EXPECT_THAT(calls(), ElementsAre(buildCall_));
    EXPECT_THAT(stage(), ElementsAre("regs/other.reg"));
    EXPECT_THAT(links(), IsEmpty());
    mustRunStaged("remove");
    EXPECT_THAT(stage(), ElementsAre("regs/other.reg"));
}

TEST_F(Sfcb, removingNeedsTheStagingFolder)
{
    const Ended ended = runRegister({"remove"});
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err, HasSubstr("/var/lib/sfcb/stage is no folder: --staging-folder"));
    EXPECT_THAT(calls(), IsEmpty());
}

TEST_F(Sfcb, registersInAnotherNamespaceWithoutTheComputerSystem)
{
    mustRunStaged("register", {"--namespace", "root/sensors", "--without-computer-system"});
    EXPECT_THAT(
        stage(), ElementsAre("mofs/root/sensors/sensor-profile.mof", "regs/sensor-profile.reg"));
    EXPECT_THAT(links(), ElementsAre("libSensorProfileProvider.so"));
    const Lines shipped = linesOf(contentOf(shared("registration/sensor-profile.reg")));
    Lines expected(shipped.begin(), shipped.end() - 6); // the block of the computer system
    for (std::string& line : expected)
        if (line == "   namespace: root/cimv2")
            line = "   namespace: root/sensors";
    EXPECT_EQ(linesOf(contentOf(path("stage/regs/sensor-profile.reg"))), expected);
    mustRunStaged("remove", {"--namespace", "root/sensors"});
    EXPECT_THAT(stage(), IsEmpty());
}

TEST_F(Sfcb, dryRunPrintsTheStepsAndTakesNone)
{
    const Lines planned = linesOf(mustRunStaged("register", {"--dry-run"}));
    EXPECT_EQ(planned.at(2), stageCall_);
    EXPECT_EQ(planned.at(3), buildCall_);
    EXPECT_THAT(calls(), IsEmpty());
    EXPECT_THAT(stage(), IsEmpty());
    EXPECT_THAT(links(), IsEmpty());
    mustRunStaged("register");
    EXPECT_THAT(mustRunStaged("remove", {"--dry-run"}), Not(HasSubstr("Removed")));
    EXPECT_EQ(stage().size(), 2U);
    EXPECT_EQ(links().size(), 2U);
}

// Whichever step fails, the message lists the steps before it, the command that it names undoes
// them, and repeating the registration succeeds.
class EveryStepOfSfcb : public Sfcb, public testing::WithParamInterface<std::size_t> {};

TEST_P(EveryStepOfSfcb, canFailAndBeUndone)
{
    addCommand("ln");
    const Lines steps = {"ln -s " + library("libSensorProfileProvider.so") + " " +
                             path("providers/libSensorProfileProvider.so"),
        "ln -s " + library("libComputerSystemProvider.so") + " " +
            path("providers/libComputerSystemProvider.so"),
        stageCall_, buildCall_};
    const std::size_t done = GetParam();
    failAt(done + 1);
    const Ended ended = runStaged("register");
    EXPECT_EQ(ended.code, 1);
    std::string report = "failed with exit code 7: " + steps[done] + "\n";
    report += done == 0 ? "Nothing was changed.\n" : "Done before that:\n";
    for (std::size_t i = 0; i < done; ++i)
        report += "  " + steps[i] + "\n";
    if (done > 0)
        report += "To undo it: sensor-profile-register remove --object-manager sfcb --namespace "
                  "root/cimv2 --provider-folder " +
                  path("providers") + " --staging-folder " + path("stage") + "\n";
    EXPECT_THAT(ended.err, HasSubstr(report));
    EXPECT_EQ(calls().size(), done + 1);

    failNoMore();
    mustRun({"remove", "--object-manager", "sfcb", "--namespace", "root/cimv2", "--provider-folder",
        path("providers"), "--staging-folder", path("stage")});
    EXPECT_THAT(links(), IsEmpty());
    EXPECT_THAT(stage(), IsEmpty());
    mustRunStaged("register");
    EXPECT_EQ(stage().size(), 2U);
}

INSTANTIATE_TEST_SUITE_P(Steps, EveryStepOfSfcb, testing::Range<std::size_t>(0, 4));

TEST_F(Sfcb, aRemovalThatFailedBuildsTheRepositoryWhenRepeated)
{
    mustRunStaged("register");
    calls();
    failAt(1);
    const Ended ended = runStaged("remove");
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err, HasSubstr("failed with exit code 7: " + buildCall_));
    EXPECT_THAT(ended.err, HasSubstr("Done before that:\n  rm "));
    failNoMore();
    calls();
    mustRunStaged("remove");
    EXPECT_THAT(calls(), ElementsAre(buildCall_));
    EXPECT_THAT(links(), IsEmpty());
}

} // namespace
