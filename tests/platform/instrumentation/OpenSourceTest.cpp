// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/Instrumentation.h"
#include "tests/platform/instrumentation/Walk.h"
#include "tests/support/Environment.h"

#include <gmock/gmock.h>

namespace OpenSourceTests {

using Testing::EnvironmentVariable;
using Testing::errorOf;
using testing::HasSubstr;
using Vorn::Instrumentation;

TEST(OpenSourceTest, NamesAnUnknownKindOfSource)
{
    const EnvironmentVariable environment("VORN_INSTRUMENTATION", "ipmb:3");
    EXPECT_THAT(errorOf([] { Instrumentation cursor; }),
        testing::AllOf(HasSubstr("\"ipmb:3\""), HasSubstr("hwmon, ipmi, model")));
}

TEST(OpenSourceTest, NamesWrongArguments)
{
    const EnvironmentVariable noFile("VORN_INSTRUMENTATION", "model");
    EXPECT_THAT(errorOf([] { Instrumentation cursor; }), HasSubstr("\"model\" names no file"));
    const EnvironmentVariable argument("VORN_INSTRUMENTATION", "hwmon:x");
    EXPECT_THAT(errorOf([] { Instrumentation cursor; }), HasSubstr("\"hwmon:x\""));
}

TEST(OpenSourceTest, RefusesAnEmptyEntry)
{
    const EnvironmentVariable environment("VORN_INSTRUMENTATION", "hwmon,");
    EXPECT_THAT(errorOf([] { Instrumentation cursor; }), HasSubstr("\"hwmon,\""));
}

TEST(OpenSourceTest, TakesAnEmptyListForTheDefault)
{
    const EnvironmentVariable environment("VORN_INSTRUMENTATION", "");
    EXPECT_NO_THROW(Instrumentation());
}

} // namespace OpenSourceTests
