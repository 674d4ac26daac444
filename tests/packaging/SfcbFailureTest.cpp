// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Tests of steps of registering in sfcb that fail.

#include "tests/packaging/SfcbTest.h"

namespace SfcbTests {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

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
