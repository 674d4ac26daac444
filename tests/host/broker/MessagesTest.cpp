// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Messages.h"

#include "host/broker/String.h"
#include "tests/host/broker/BrokerTest.h"
#include "tests/support/LogCapture.h"

#include <tuple>
#include <vector>

namespace HostTests {

using MessagesTest = BrokerTest;

TEST_F(MessagesTest, LevelsBecomeLevelsOfTheTraceChannel)
{
    const Testing::LogCapture capture;
    const CMPIString handleless{nullptr, &Host::String::functions};
    CMTraceMessage(mb, CMPI_LEV_WARNING, "Component", "a   warning.", nullptr);
    CMTraceMessage(mb, CMPI_LEV_INFO, "Component", "information", string("more"));
    CMTraceMessage(mb, CMPI_LEV_VERBOSE, "Component", nullptr, string("verbose"));
    CMTraceMessage(mb, CMPI_LEV_VERBOSE, "Component", "text", &handleless);
    std::vector<std::tuple<int, std::string>> lines;
    for (const Testing::LogLine& line : capture.trace()) {
        EXPECT_EQ(line.component, "Component");
        EXPECT_EQ(line.function, "trace");
        lines.emplace_back(line.level, line.text);
    }
    EXPECT_THAT(lines,
        testing::ElementsAre(std::tuple(6000, "a   warning."), std::tuple(4000, "information more"),
            std::tuple(3000, "verbose"), std::tuple(3000, "text")));
    EXPECT_TRUE(capture.log().empty());
}

} // namespace HostTests
