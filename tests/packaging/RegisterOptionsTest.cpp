// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Tests of how sensor-profile-register chooses the object manager and which options it refuses.

#include "tests/packaging/RegisterTest.h"

namespace RegisterOptionsTests {

using testing::HasSubstr;
using testing::IsEmpty;
using namespace Testing;

class WithoutObjectManagerTest : public RegisterTest {
protected:
    WithoutObjectManagerTest() : RegisterTest({"cimmof", "sfcbrepos"}) {}

    void expectRefusal(const Lines& arguments, int code, const std::string& reason) const
    {
        const Ended ended = runRegister(arguments);
        EXPECT_EQ(ended.code, code) << testing::PrintToString(arguments);
        EXPECT_THAT(ended.err, HasSubstr(reason));
        EXPECT_THAT(ended.err, testing::StartsWith("sensor-profile-register: "));
        EXPECT_EQ(ended.out, "");
        EXPECT_THAT(calls(), IsEmpty());
    }
};

TEST_F(WithoutObjectManagerTest, SaysThatNoneIsThere)
{
    expectRefusal({"register"}, 1, "neither OpenPegasus (cimmof, cimprovider) nor sfcb");
}

TEST_F(WithoutObjectManagerTest, SaysWhichCommandOfTheNamedOneIsMissing)
{
    expectRefusal({"register", "--object-manager", "openpegasus"}, 1,
        "cimprovider of openpegasus is not installed");
    expectRefusal({"remove", "--object-manager=sfcb"}, 1, "sfcbstage of sfcb is not installed");
}

TEST_F(WithoutObjectManagerTest, RefusesCommandLinesThatMakeNoSense)
{
    expectRefusal({}, 2, "a command is missing");
    expectRefusal({"install"}, 2, "unknown command install");
    expectRefusal({"register", "remove"}, 2, "register and remove exclude each other");
    expectRefusal({"register", "register"}, 2, "register stands there twice");
    expectRefusal({"register", "--dry-run=yes"}, 2, "--dry-run takes no value");
    expectRefusal({"--help=1"}, 2, "--help takes no value");
    expectRefusal({"register", "--without-computer-system=no"}, 2, "takes no value");
    expectRefusal({"register", "--force"}, 2, "unknown option --force");
    expectRefusal({"register", "-n"}, 2, "unknown option -n");
    expectRefusal({"register", "--namespace"}, 2, "--namespace needs a value");
    expectRefusal({"register", "--object-manager", "other"}, 2,
        "--object-manager takes openpegasus or sfcb, not other");
    expectRefusal({"register", "--provider-folder", "/no/such"}, 2, "there is no folder /no/such");
    expectRefusal({"register", "--staging-folder=/no/such"}, 2, "there is no folder /no/such");
    expectRefusal({"remove", "--without-computer-system"}, 2, "is for register");
    for (const char* const name :
        {"", "/root", "root/", "root//cimv2", "root cimv2", "root/&", "1"})
        expectRefusal({"register", "--namespace", name}, 2, "is no namespace");
}

TEST_F(WithoutObjectManagerTest, RefusesTheNamespacesOfRegisteredProfiles)
{
    for (const std::string name : {"root/interop", "ROOT/Interop", "interop", "Interop",
             "root/PG_InterOp", "root/pg_interop"})
        expectRefusal({"register", "--namespace", name}, 2,
            name + " is the namespace of registered profiles");
}

TEST_F(WithoutObjectManagerTest, ExplainsItself)
{
    const std::string help = mustRun({"--help"});
    EXPECT_THAT(help, HasSubstr("Usage: sensor-profile-register register|remove"));
    EXPECT_THAT(help, HasSubstr("--dry-run"));
}

class BothObjectManagersTest : public RegisterTest {
protected:
    BothObjectManagersTest() : RegisterTest({"cimmof", "cimprovider", "sfcbstage", "sfcbrepos"}) {}
};

TEST_F(BothObjectManagersTest, MustBeChosenFrom)
{
    const Ended ended = runRegister({"register"});
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err, HasSubstr("--object-manager says which is meant"));
    EXPECT_THAT(calls(), IsEmpty());
}

TEST_F(BothObjectManagersTest, AreChosenByName)
{
    mustRun({"register", "--object-manager", "sfcb"});
    EXPECT_THAT(calls().at(0), testing::StartsWith("sfcbstage "));
    mustRun({"register", "--object-manager", "openpegasus"});
    EXPECT_EQ(calls().at(0), "cimprovider -l");
}

} // namespace RegisterOptionsTests
