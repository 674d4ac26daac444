// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Registering in OpenPegasus.

#include "tests/packaging/RegisterTest.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using namespace Testing;
namespace fs = std::filesystem;

class OpenPegasus : public RegisterTest {
protected:
    OpenPegasus() : RegisterTest({"cimmof", "cimprovider"})
    {
        fs::create_directory(path("providers"));
    }

    // Into a folder of providers that is not the one where the libraries lie.
    Lines linking(const std::string& action, Lines more = {}) const
    {
        more.insert(more.begin(), {action, "--provider-folder", path("providers")});
        return more;
    }

    Lines modules() const { return linesOf(contentOf(path("modules"))); }
    Lines links() const { return filesBelow(path("providers")); }

    const std::string classes_ = shared("sensor-profile.mof");
    const std::string registration_ = shared("registration/sensor-profile-registration.mof");
};

TEST_F(OpenPegasus, registersTheClassesThenTheProviders)
{
    const std::string out = mustRun({"register"});
    EXPECT_THAT(calls(), ElementsAre("cimprovider -l", "cimmof -uc -n root/cimv2 " + classes_,
                             "cimmof -n root/PG_InterOp " + registration_));
    EXPECT_THAT(modules(), ElementsAre("SensorProfileModule", "SensorProfileComputerSystemModule"));
    EXPECT_THAT(out, HasSubstr("Registered in root/cimv2."));
    EXPECT_THAT(out, HasSubstr("must look for provider libraries in " +
                               (movedInstallation() / "lib/cmpi").string()));
}

TEST_F(OpenPegasus, replacesWhatIsRegistered)
{
    mustRun({"register"});
    calls();
    mustRun({"register"});
    EXPECT_THAT(calls(), ElementsAre("cimprovider -l", "cimmof -uc -n root/cimv2 " + classes_,
                             "cimprovider -r -m SensorProfileModule",
                             "cimprovider -r -m SensorProfileComputerSystemModule",
                             "cimmof -n root/PG_InterOp " + registration_));
    EXPECT_THAT(modules(), ElementsAre("SensorProfileModule", "SensorProfileComputerSystemModule"));
}

TEST_F(OpenPegasus, leavesTheModulesOfOthersAlone)
{
    folder_.write("modules", "OtherModule\nSensorProfileModule2\nMySensorProfileModule\n");
    mustRun({"register"});
    mustRun({"remove"});
    EXPECT_THAT(
        modules(), ElementsAre("OtherModule", "SensorProfileModule2", "MySensorProfileModule"));
}

TEST_F(OpenPegasus, removesTheProviders)
{
    mustRun({"register"});
    calls();
    EXPECT_THAT(mustRun({"remove"}), HasSubstr("Removed."));
    EXPECT_THAT(calls(), ElementsAre("cimprovider -l", "cimprovider -r -m SensorProfileModule",
                             "cimprovider -r -m SensorProfileComputerSystemModule"));
    EXPECT_THAT(modules(), IsEmpty());
}

TEST_F(OpenPegasus, removesNothingWhereNothingIsRegistered)
{
    EXPECT_THAT(mustRun({"remove"}), HasSubstr("nothing was changed"));
    EXPECT_THAT(calls(), ElementsAre("cimprovider -l"));
}

TEST_F(OpenPegasus, linksTheLibrariesIntoTheFolderOfProviders)
{
    EXPECT_THAT(mustRun(linking("register")), Not(HasSubstr("must look")));
    for (const char* const name : {"libSensorProfileProvider.so", "libComputerSystemProvider.so"})
        EXPECT_EQ(fs::read_symlink(path("providers") + "/" + name), library(name));
    EXPECT_THAT(
        links(), ElementsAre("libComputerSystemProvider.so", "libSensorProfileProvider.so"));
    mustRun(linking("register"));
    EXPECT_EQ(links().size(), 2U);
    mustRun(linking("remove"));
    EXPECT_THAT(links(), IsEmpty());
}

TEST_F(OpenPegasus, refusesToTakeThePlaceOfAnotherLibrary)
{
    folder_.write("providers/libComputerSystemProvider.so", "another one");
    const Ended ended = runRegister(linking("register"));
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err,
        HasSubstr(path("providers/libComputerSystemProvider.so") + " is somebody else's"));
    EXPECT_THAT(ended.err, HasSubstr("Nothing was changed."));
    EXPECT_THAT(calls(), ElementsAre("cimprovider -l"));
    EXPECT_THAT(links(), ElementsAre("libComputerSystemProvider.so"));

    mustRun(linking("register", {"--without-computer-system"}));
    EXPECT_EQ(contentOf(path("providers/libComputerSystemProvider.so")), "another one");
    mustRun(linking("remove"));
    EXPECT_THAT(links(), ElementsAre("libComputerSystemProvider.so"));
}

TEST_F(OpenPegasus, registersTheSensorsWithoutTheComputerSystem)
{
    mustRun(linking("register"));
    mustRun(linking("register", {"--without-computer-system"}));
    EXPECT_THAT(modules(), ElementsAre("SensorProfileModule"));
    EXPECT_THAT(links(), ElementsAre("libSensorProfileProvider.so"));
    const std::string document = contentOf(path("sensor-profile-registration.mof"));
    EXPECT_THAT(document, HasSubstr("ClassName = \"ZUMLO_SensorSystemDevice\""));
    EXPECT_THAT(document, Not(HasSubstr("ClassName = \"ZUMLO_ComputerSystem\"")));
}

TEST_F(OpenPegasus, registersInAnotherNamespace)
{
    EXPECT_THAT(mustRun({"register", "--namespace=root/sensors_2"}),
        HasSubstr("Registered in root/sensors_2."));
    EXPECT_THAT(calls()[1], "cimmof -uc -n root/sensors_2 " + classes_);
    std::string document = contentOf(registration_);
    for (auto at = document.find("root/cimv2"); at != std::string::npos;
         at = document.find("root/cimv2"))
        document.replace(at, 10, "root/sensors_2");
    EXPECT_EQ(contentOf(path("sensor-profile-registration.mof")), document);
}

TEST_F(OpenPegasus, dryRunPrintsTheStepsAndTakesNone)
{
    const Lines planned = linesOf(mustRun(linking("register", {"--dry-run"})));
    EXPECT_THAT(calls(), ElementsAre("cimprovider -l"));
    EXPECT_THAT(links(), IsEmpty());
    EXPECT_EQ(planned.back(), "This was a dry run: nothing was done.");
    const Lines done = linesOf(mustRun(linking("register")));
    EXPECT_THAT(done,
        ElementsAre(planned[0], planned[1], planned[2], planned[3], "Registered in root/cimv2."));
    EXPECT_EQ(planned[2], "cimmof -uc -n root/cimv2 " + classes_);

    const Lines removal = linesOf(mustRun(linking("remove", {"--dry-run"})));
    EXPECT_EQ(removal[0], "cimprovider -r -m SensorProfileModule");
    EXPECT_EQ(modules().size(), 2U);
    EXPECT_EQ(links().size(), 2U);
}

TEST_F(OpenPegasus, aServerThatDoesNotAnswerIsAFailureBeforeAnyStep)
{
    failAt(1);
    for (const char* const action : {"register", "remove"}) {
        const Ended ended = runRegister(linking(action));
        EXPECT_EQ(ended.code, 1);
        EXPECT_THAT(ended.err, HasSubstr("cimprovider -l failed with exit code 7"));
        EXPECT_THAT(ended.err, HasSubstr("Nothing was changed."));
        EXPECT_THAT(links(), IsEmpty());
        calls();
    }
}

// Whichever step fails, the message lists the steps before it, the command that it names undoes
// them, and repeating the registration succeeds.
class EveryStepOfOpenPegasus : public OpenPegasus, public testing::WithParamInterface<std::size_t> {
protected:
    EveryStepOfOpenPegasus()
    {
        addCommand("ln");
        folder_.write("modules", "SensorProfileModule\nSensorProfileComputerSystemModule\n");
    }

    std::string linkStep(const std::string& name) const
    {
        return "ln -s " + library(name) + " " + path("providers/" + name);
    }

    const Lines steps_ = {linkStep("libSensorProfileProvider.so"),
        linkStep("libComputerSystemProvider.so"), "cimmof -uc -n root/cimv2 " + classes_,
        "cimprovider -r -m SensorProfileModule",
        "cimprovider -r -m SensorProfileComputerSystemModule",
        "cimmof -n root/PG_InterOp " + registration_};
};

TEST_P(EveryStepOfOpenPegasus, canFailAndBeUndone)
{
    const std::size_t done = GetParam();
    failAt(done + 2); // the first call asks what is registered
    const Ended ended = runRegister(linking("register"));
    EXPECT_EQ(ended.code, 1);
    std::string report = "failed with exit code 7: " + steps_[done] + "\n";
    report += done == 0 ? "Nothing was changed.\n" : "Done before that:\n";
    for (std::size_t i = 0; i < done; ++i)
        report += "  " + steps_[i] + "\n";
    if (done > 0)
        report += "To undo it: sensor-profile-register remove --object-manager openpegasus "
                  "--namespace root/cimv2 --provider-folder " +
                  path("providers") + "\n";
    EXPECT_THAT(ended.err, HasSubstr(report));
    EXPECT_EQ(calls().size(), done + 2);

    failNoMore();
    mustRun({"remove", "--object-manager", "openpegasus", "--namespace", "root/cimv2",
        "--provider-folder", path("providers")});
    EXPECT_THAT(modules(), IsEmpty());
    EXPECT_THAT(links(), IsEmpty());
    mustRun(linking("register"));
    EXPECT_EQ(modules().size(), 2U);
}

INSTANTIATE_TEST_SUITE_P(Steps, EveryStepOfOpenPegasus, testing::Range<std::size_t>(0, 6));

TEST_F(OpenPegasus, aRemovalThatFailedGoesOnWhereItEnded)
{
    mustRun(linking("register"));
    calls();
    failAt(3);
    const Ended ended = runRegister(linking("remove"));
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err,
        HasSubstr("failed with exit code 7: cimprovider -r -m SensorProfileComputerSystemModule"));
    EXPECT_THAT(ended.err, HasSubstr("  cimprovider -r -m SensorProfileModule\n"));
    EXPECT_THAT(ended.err, Not(HasSubstr("To undo it")));
    failNoMore();
    calls();
    mustRun(linking("remove"));
    EXPECT_THAT(calls(),
        ElementsAre("cimprovider -l", "cimprovider -r -m SensorProfileComputerSystemModule"));
    EXPECT_THAT(links(), IsEmpty());
}

} // namespace
