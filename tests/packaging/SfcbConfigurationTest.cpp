// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Tests of the folders that sfcb's configuration or the caller names.

#include "tests/packaging/SfcbTest.h"

namespace SfcbTests {

using testing::AllOf;
using testing::AnyOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
namespace fs = std::filesystem;

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

} // namespace SfcbTests
