// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Steps of registering in OpenPegasus that fail, and the advice to undo them.

#include "tests/packaging/OpenPegasusTest.h"

#include <csignal>

namespace OpenPegasusTests {

using testing::AllOf;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
namespace fs = std::filesystem;

TEST_F(OpenPegasusTest, AServerThatDoesNotAnswerIsAFailureBeforeAnyStep)
{
    failAt(1);
    for (const char* const action : {"register", "remove"}) {
        const Ended ended = runRegister({action});
        EXPECT_EQ(ended.code, 1);
        EXPECT_THAT(ended.err, AllOf(HasSubstr("cimprovider -l failed with exit code 7"),
                                   HasSubstr("Nothing was changed.")));
        EXPECT_THAT(links(), IsEmpty());
        calls();
    }
}

class EveryFirstStepOfOpenPegasusTest : public EveryStepOf<OpenPegasusTest> {};

TEST_P(EveryFirstStepOfOpenPegasusTest, CanFailAndBeUndone)
{
    const std::string message = failing(1, {"register"},
        {linkStep(sensorLibrary_), linkStep(systemLibrary_), systemStep_, sensorStep_,
            conformanceStep_, interopStep_, profileStep_, registrationStep_});
    mustRunAdvice(message, "To undo it: ", "\n");
    EXPECT_THAT(modules(), IsEmpty());
    EXPECT_THAT(links(), IsEmpty());
    mustRun({"register"});
    EXPECT_EQ(modules(), modules_);
}

INSTANTIATE_TEST_SUITE_P(Steps, EveryFirstStepOfOpenPegasusTest, testing::Range<std::size_t>(0, 8));

// The advice restores the earlier registration instead of removing it.
class EveryRepeatedStepOfOpenPegasusTest : public EveryStepOf<OpenPegasusTest> {};

TEST_P(EveryRepeatedStepOfOpenPegasusTest, CanFailAndLeadBack)
{
    mustRun({"register", "--namespace", "root/old"});
    const std::string earlier = contentOf(path("sensor-profile-registration.mof"));
    for (const std::string& link : links())
        fs::remove(path("providers/" + link));
    const std::string message = failing(2, {"register"},
        {linkStep(sensorLibrary_), linkStep(systemLibrary_), systemStep_, sensorStep_,
            conformanceStep_, interopStep_, profileStep_, "cimprovider -r -m SensorProfileModule",
            "cimprovider -r -m SensorProfileRegistrationModule",
            "cimprovider -r -m SensorProfileComputerSystemModule", registrationStep_});
    mustRunAdvice(message, "To undo it: ", "\n");
    EXPECT_EQ(contentOf(path("sensor-profile-registration.mof")), earlier);
    EXPECT_EQ(modules(), modules_);
    EXPECT_EQ(links().size(), 2U);
}

INSTANTIATE_TEST_SUITE_P(
    Steps, EveryRepeatedStepOfOpenPegasusTest, testing::Range<std::size_t>(0, 11));

class EveryRemovalStepOfOpenPegasusTest : public EveryStepOf<OpenPegasusTest> {};

TEST_P(EveryRemovalStepOfOpenPegasusTest, CanFailAndBeRepeated)
{
    mustRun({"register"});
    failing(2, {"remove"},
        {"cimprovider -r -m SensorProfileModule",
            "cimprovider -r -m SensorProfileRegistrationModule",
            "cimprovider -r -m SensorProfileComputerSystemModule", unlinkStep(sensorLibrary_),
            unlinkStep(systemLibrary_)});
    mustRun({"remove"});
    EXPECT_THAT(modules(), IsEmpty());
    EXPECT_THAT(links(), IsEmpty());
}

INSTANTIATE_TEST_SUITE_P(
    Steps, EveryRemovalStepOfOpenPegasusTest, testing::Range<std::size_t>(0, 5));

TEST_F(OpenPegasusTest, DeletionOfClassesCanFailAndBeRepeated)
{
    const std::vector<std::pair<std::size_t, std::string>> failures = {{6, "cimcli ns"},
        {7, "cimcli nc -di -n root/PG_InterOp"},
        {8, "cimcli dc ZUMLO_SensorElementConformsToProfile -n root/PG_InterOp"}};
    for (const auto& [call, command] : failures) {
        mustRun({"register"});
        calls();
        failAt(call);
        const Ended ended = runRegister({"remove"});
        EXPECT_EQ(ended.code, 1);
        EXPECT_THAT(ended.err, AllOf(HasSubstr("failed with exit code 7: " + command),
                                   HasSubstr("the command can be repeated")));
        failNoMore();
        mustRun({"remove"});
        EXPECT_THAT(classesIn("root/PG_InterOp"), IsEmpty());
    }
}

TEST_F(OpenPegasusTest, AnUndoneRemovalIsARegistrationAsItWas)
{
    mustRun({"register", "--namespace", "root/old", "--without-computer-system"});
    calls();
    failAt(3);
    const Ended ended = runRegister({"remove"});
    EXPECT_THAT(ended.err, HasSubstr("To undo it: " + program_ +
                                     " register --object-manager openpegasus --namespace root/old "
                                     "--without-computer-system --provider-folder " +
                                     path("providers") + "\n"));
}

// A part of it may be there: SensorProfileModule is removed first.
TEST_F(OpenPegasusTest, TheNamespaceIsThatOfAnyModule)
{
    mustRun({"register", "--namespace", "root/old"});
    folder_.write("modules", "SensorProfileRegistrationModule\n");
    calls();
    failAt(3);
    EXPECT_THAT(runRegister({"register"}).err, HasSubstr(" --namespace root/old "));
}

// A removal would take the earlier registration away.
TEST_F(OpenPegasusTest, AnUnknownNamespaceLeadsToNoAdvice)
{
    mustRun({"register"});
    for (const bool hasCommand : {true, false}) {
        if (hasCommand)
            fs::remove(path("sensor-profile-registration.mof"));
        else
            fs::remove(path("bin/cimcli"));
        calls();
        failAt(hasCommand ? 7 : 4);
        const Ended ended = runRegister({"register"});
        EXPECT_THAT(ended.err, AllOf(HasSubstr("failed with exit code 7: " + conformanceStep_),
                                   Not(HasSubstr("To undo it")), Not(HasSubstr("cimcli")),
                                   HasSubstr("the command can be repeated")));
    }
}

// The signal also ends a command that hangs.
TEST_F(OpenPegasusTest, ASignalDuringAStepIsAFailureOfIt)
{
    folder_.write("hang-at", "2");
    const std::string script = "env --default-signal=INT \"$@\" &\n"
                               "until [ -e \"$STAND_IN/hanging\" ]; do sleep 0.02; done\n"
                               "kill -$0 $!\n"
                               "wait $!";
    for (const std::string signal : {"INT", "TERM", "HUP"}) {
        const Ended ended = runWords({"/bin/bash", "-c", script, signal, program_, "register",
            "--provider-folder", path("providers")});
        EXPECT_EQ(ended.code, 1) << signal;
        EXPECT_THAT(ended.err, AllOf(HasSubstr("sensor-profile-register: interrupted: " +
                                               systemStep_ + "\nIt may have done part of its work"),
                                   HasSubstr("To undo it: " + program_ + " remove ")));
        EXPECT_EQ(::kill(std::stoi(contentOf(path("hanging"))), 0), -1);
        calls();
        fs::remove(path("hanging"));
    }
}

// The advice names the command without its folder when PATH leads to it.
TEST_F(OpenPegasusTest, AdviceNamesTheCommandAsItIsFound)
{
    fs::create_symlink(program_, path("bin/sensor-profile-register"));
    failAt(2);
    EXPECT_THAT(runWords({path("bin/sensor-profile-register"), "register", "--provider-folder",
                             path("providers")})
                    .err,
        HasSubstr("To undo it: sensor-profile-register remove "));
}

} // namespace OpenPegasusTests
