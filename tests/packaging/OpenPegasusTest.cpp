// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Tests of registering in OpenPegasus.

#include "tests/packaging/OpenPegasusTest.h"

namespace OpenPegasusTests {

using testing::AllOf;
using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
namespace fs = std::filesystem;

TEST_F(OpenPegasusTest, RegistersTheClassesThenTheProviders)
{
    EXPECT_THAT(mustRun({"register"}), HasSubstr("Registered in root/cimv2."));
    EXPECT_THAT(calls(), ElementsAre("cimprovider -l", systemStep_, sensorStep_, conformanceStep_,
                             interopStep_, profileStep_, registrationStep_));
    EXPECT_THAT(modules(), ElementsAreArray(modules_));
}

TEST_F(OpenPegasusTest, ReplacesWhatIsRegistered)
{
    mustRun({"register"});
    calls();
    mustRun({"register"});
    EXPECT_THAT(calls(),
        ElementsAre("cimprovider -l", namespaceQuery_, systemStep_, sensorStep_, conformanceStep_,
            interopStep_, profileStep_, "cimprovider -r -m SensorProfileModule",
            "cimprovider -r -m SensorProfileRegistrationModule",
            "cimprovider -r -m SensorProfileComputerSystemModule", registrationStep_));
    EXPECT_THAT(modules(), ElementsAreArray(modules_));
}

TEST_F(OpenPegasusTest, LeavesTheModulesOfOthersAlone)
{
    folder_.write("modules", "OtherModule\nSensorProfileModule2\nMySensorProfileModule\n");
    mustRun({"register"});
    mustRun({"remove"});
    EXPECT_THAT(
        modules(), ElementsAre("OtherModule", "SensorProfileModule2", "MySensorProfileModule"));
}

TEST_F(OpenPegasusTest, RemovesTheProviders)
{
    mustRun({"register"});
    calls();
    EXPECT_THAT(mustRun({"remove"}), HasSubstr("Removed."));
    EXPECT_THAT(calls(),
        ElementsAre("cimprovider -l", namespaceQuery_, "cimprovider -r -m SensorProfileModule",
            "cimprovider -r -m SensorProfileRegistrationModule",
            "cimprovider -r -m SensorProfileComputerSystemModule", "cimcli ns",
            "cimcli nc -di -n root/PG_InterOp",
            "cimcli dc ZUMLO_SensorElementConformsToProfile -n root/PG_InterOp",
            "cimcli dc ZUMLO_SensorRegisteredProfile -n root/PG_InterOp",
            "cimcli nc -di -n root/cimv2",
            "cimcli dc ZUMLO_SensorElementConformsToProfile -n root/cimv2",
            "cimcli dc ZUMLO_SensorElementCapabilities -n root/cimv2",
            "cimcli dc ZUMLO_SensorSystemDevice -n root/cimv2",
            "cimcli dc ZUMLO_SensorEnabledLogicalElementCapabilities -n root/cimv2",
            "cimcli dc ZUMLO_NumericSensor -n root/cimv2",
            "cimcli dc ZUMLO_ComputerSystem -n root/cimv2"));
    EXPECT_THAT(modules(), IsEmpty());
}

TEST_F(OpenPegasusTest, RemovesTheClassesFromEveryNamespace)
{
    mustRun({"register", "--namespace", "root/old"});
    mustRun({"register", "--namespace", "root/new"});
    folder_.write("classes/root/new/ZUMLO_Other", "");
    mustRun({"remove"});
    EXPECT_THAT(classesIn("root/old"), IsEmpty());
    EXPECT_THAT(classesIn("root/new"), ElementsAre("ZUMLO_Other"));
    EXPECT_THAT(classesIn("root/PG_InterOp"), IsEmpty());
}

// Somebody else may have defined it.
TEST_F(OpenPegasusTest, LeavesTheClassOfComputerSystemsWhereItServesNone)
{
    mustRun({"register", "--without-computer-system"});
    mustRun({"remove"});
    EXPECT_THAT(classesIn("root/cimv2"), ElementsAre("ZUMLO_ComputerSystem"));
}

TEST_F(OpenPegasusTest, WithoutTheCommandThatDeletesThemTheClassesStay)
{
    mustRun({"register"});
    fs::remove(path("bin/cimcli"));
    EXPECT_THAT(mustRun({"remove"}),
        AllOf(HasSubstr("The classes stay, since cimcli"), HasSubstr("Removed.")));
    EXPECT_FALSE(classesIn("root/cimv2").empty());
}

// cimprovider removes a module from all its namespaces.
TEST_F(OpenPegasusTest, RemovesFromNoSingleNamespace)
{
    mustRun({"register", "--namespace", "root/old"});
    mustRun({"register", "--namespace", "root/new"});
    calls();
    const Ended ended = runRegister({"remove", "--namespace", "root/old"});
    EXPECT_EQ(ended.code, 2);
    EXPECT_THAT(ended.err, HasSubstr("remove takes everything from OpenPegasus"));
    EXPECT_THAT(calls(), IsEmpty());
    EXPECT_EQ(modules(), modules_);
}

TEST_F(OpenPegasusTest, RemovesNothingWhereNothingIsRegistered)
{
    EXPECT_THAT(mustRun({"remove"}), HasSubstr("nothing was changed"));
    EXPECT_THAT(calls(), ElementsAre("cimprovider -l", "cimcli ns"));
}

TEST_F(OpenPegasusTest, LinksTheLibrariesIntoTheFolderOfProviders)
{
    EXPECT_THAT(mustRun({"register"}), Not(HasSubstr("must look")));
    for (const char* const name :
        {"libSensorProfileProvider.so", "libSensorProfileComputerSystem.so"})
        EXPECT_EQ(fs::read_symlink(path("providers") + "/" + name), library(name));
    EXPECT_THAT(
        links(), ElementsAre("libSensorProfileComputerSystem.so", "libSensorProfileProvider.so"));
    mustRun({"register"});
    EXPECT_EQ(links().size(), 2U);
    mustRun({"remove"});
    EXPECT_THAT(links(), IsEmpty());
}

TEST_F(OpenPegasusTest, ReplacesTheLinkOfTheLibrarysFormerName)
{
    addFormerLink();
    mustRun({"register"});
    EXPECT_THAT(
        links(), ElementsAre("libSensorProfileComputerSystem.so", "libSensorProfileProvider.so"));
    addFormerLink();
    mustRun({"remove"});
    EXPECT_THAT(links(), IsEmpty());
}

TEST_F(OpenPegasusTest, LeavesALibraryOfTheFormerNameAlone)
{
    folder_.write("providers/libComputerSystemProvider.so", "another one");
    mustRun({"register"});
    mustRun({"remove"});
    EXPECT_THAT(links(), ElementsAre("libComputerSystemProvider.so"));
}

TEST_F(OpenPegasusTest, RefusesToTakeThePlaceOfAnotherLibrary)
{
    folder_.write("providers/libSensorProfileComputerSystem.so", "another one");
    const Ended ended = runRegister({"register"});
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err, AllOf(HasSubstr(path("providers/libSensorProfileComputerSystem.so") +
                                           " is somebody else's"),
                               HasSubstr("Nothing was changed.")));
    EXPECT_THAT(calls(), ElementsAre("cimprovider -l"));
    EXPECT_THAT(links(), ElementsAre("libSensorProfileComputerSystem.so"));

    mustRun({"remove"});
    EXPECT_THAT(links(), ElementsAre("libSensorProfileComputerSystem.so"));
}

TEST_F(OpenPegasusTest, RegistersTheSensorsWithoutTheComputerSystem)
{
    mustRun({"register"});
    calls();
    mustRun({"register", "--without-computer-system"});
    EXPECT_THAT(calls(),
        ElementsAre("cimprovider -l", namespaceQuery_, addingStep_, sensorStep_, conformanceStep_,
            interopStep_, profileStep_, "cimprovider -r -m SensorProfileModule",
            "cimprovider -r -m SensorProfileRegistrationModule",
            "cimprovider -r -m SensorProfileComputerSystemModule",
            "cimmof -n root/PG_InterOp sensor-profile-registration.mof"));
    EXPECT_THAT(modules(), ElementsAre("SensorProfileModule", "SensorProfileRegistrationModule"));
    EXPECT_EQ(links().size(), 2U);
    EXPECT_THAT(contentOf(path("sensor-profile-registration.mof")),
        AllOf(HasSubstr("ClassName = \"ZUMLO_SensorSystemDevice\""),
            HasSubstr("ClassName = \"ZUMLO_SensorRegisteredProfile\""),
            Not(HasSubstr("ComputerSystemProvider")), testing::EndsWith("};\n\n")));
}

// An association refers to the class.
TEST_F(OpenPegasusTest, TheComputerSystemsClassIsAddedWhereItIsMissing)
{
    mustRun({"register", "--without-computer-system"});
    EXPECT_EQ(
        definition("ZUMLO_ComputerSystem"), "class ZUMLO_ComputerSystem : CIM_ComputerSystem {\n");
}

TEST_F(OpenPegasusTest, SomebodyElsesComputerSystemIsLeftAlone)
{
    fs::create_directories(path("classes/root/cimv2"));
    folder_.write("classes/root/cimv2/ZUMLO_ComputerSystem", "another one");
    mustRun({"register", "--without-computer-system"});
    EXPECT_EQ(definition("ZUMLO_ComputerSystem"), "another one");
    EXPECT_THAT(definition("ZUMLO_SensorSystemDevice"), HasSubstr("CIM_SystemDevice"));
}

TEST_F(OpenPegasusTest, RegistersInAnotherNamespace)
{
    EXPECT_THAT(mustRun({"register", "--namespace=root/sensors_2"}),
        HasSubstr("Registered in root/sensors_2."));
    EXPECT_THAT(calls().at(1),
        "cimmof -uc -aV -n root/sensors_2 " + shared("sensor-profile-computer-system.mof"));
    EXPECT_EQ(contentOf(path("sensor-profile-registration.mof")),
        replaced(contentOf(registration_), "root/cimv2", "root/sensors_2"));
}

TEST_F(OpenPegasusTest, DryRunPrintsTheStepsAndTakesNone)
{
    const Lines planned = linesOf(mustRun({"register", "--dry-run"}));
    EXPECT_THAT(calls(), ElementsAre("cimprovider -l"));
    EXPECT_THAT(links(), IsEmpty());
    EXPECT_EQ(planned.back(), "This was a dry run: nothing was done.");
    Lines expected = planned;
    expected.back() = "Registered in root/cimv2.";
    EXPECT_EQ(linesOf(mustRun({"register"})), expected);
    EXPECT_EQ(planned[2], systemStep_);

    const Lines removal = linesOf(mustRun({"remove", "--dry-run"}));
    EXPECT_EQ(removal[0], "cimprovider -r -m SensorProfileModule");
    EXPECT_EQ(modules(), modules_);
    EXPECT_EQ(links().size(), 2U);
}

// Runs the commands in the example of the manual page.
TEST_F(OpenPegasusTest, PrintsWhatTheManualShows)
{
    const std::string page = replaced(
        contentOf(SENSOR_PROFILE_SOURCE_DIR "/packaging/man/sensor-profile-register.8"), "\\", "");
    const std::string start = ".Bd -literal\n";
    const auto begin = page.find(start) + start.size();
    const std::string command = "# sensor-profile-register ";
    std::string rest = "\n"; // of the output
    bool mayOmit = false;    // lines that the page leaves out
    std::size_t commands = 0;
    for (const std::string& line : linesOf(page.substr(begin, page.find("\n.Ed") - begin))) {
        if (line.starts_with(command)) {
            EXPECT_TRUE(mayOmit || rest == "\n") << rest;
            mayOmit = false;
            std::istringstream words(line.substr(command.size()));
            rest = "\n" + replaced(mustRun({std::istream_iterator<std::string>(words), {}}),
                              installedFile(""), "/usr/");
            ++commands;
        } else if (line == "&...") {
            mayOmit = true;
        } else {
            const auto found = rest.find("\n" + line + "\n");
            ASSERT_NE(found, std::string::npos) << line << rest;
            EXPECT_TRUE(mayOmit || found == 0) << line << rest;
            mayOmit = false;
            rest = rest.substr(found + 1 + line.size());
        }
    }
    EXPECT_TRUE(mayOmit || rest == "\n") << rest;
    EXPECT_EQ(commands, 2U);
}

// The libraries are linked into the machine's provider folder of OpenPegasus if it exists.
TEST_F(OpenPegasusTest, WithoutAFolderTheMachinesIsTaken)
{
    std::string expected = "must look for provider libraries in " + library();
    for (const std::string known : {"/usr/lib/Pegasus/providers", "/usr/lib64/Pegasus/providers"})
        if (fs::is_directory(known))
            expected = known + "/libSensorProfileProvider.so\n";
    EXPECT_THAT(plan({"register"}), HasSubstr(expected));
}

} // namespace OpenPegasusTests
