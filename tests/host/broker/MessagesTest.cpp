// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What providers send to the log and trace facilities.

#include "host/broker/Messages.h"

#include "host/broker/String.h"
#include "tests/host/broker/BrokerTest.h"
#include "tests/support/LogCapture.h"

#include <tuple>
#include <vector>

namespace HostTests {

class MessagesTest : public BrokerTest {
protected:
    Testing::LogCapture capture;
};

TEST_F(MessagesTest, SeveritiesBecomeLevelsOfTheLogChannel)
{
    CMLogMessage(mb, CMPI_SEV_ERROR, "ID1", "an error", nullptr);
    CMLogMessage(mb, CMPI_SEV_WARNING, nullptr, "a warning", nullptr);
    CMLogMessage(mb, CMPI_SEV_INFO, nullptr, nullptr, string("information"));
    CMLogMessage(mb, CMPI_DEV_DEBUG, nullptr, "debugging", string("more"));
    CMLogMessage(mb, static_cast<CMPISeverity>(7), nullptr, "unknown", nullptr);
    std::vector<std::tuple<int, std::string>> lines;
    for (const Testing::LogLine& line : capture.log()) {
        EXPECT_EQ(line.component, "Broker");
        lines.emplace_back(line.level, line.text);
    }
    EXPECT_THAT(lines, testing::ElementsAre(std::tuple(8000, "ID1 an error"),
                           std::tuple(7000, "a warning"), std::tuple(6000, "information"),
                           std::tuple(3000, "debugging more"), std::tuple(6000, "unknown")));
    EXPECT_TRUE(capture.trace().empty());
}

TEST_F(MessagesTest, LevelsBecomeLevelsOfTheTraceChannel)
{
    CMTraceMessage(mb, CMPI_LEV_WARNING, "Component", "a warning", nullptr);
    CMTraceMessage(mb, CMPI_LEV_INFO, "Component", "information", string("more"));
    CMTraceMessage(mb, CMPI_LEV_VERBOSE, "Component", nullptr, string("verbose"));
    std::vector<std::tuple<int, std::string>> lines;
    for (const Testing::LogLine& line : capture.trace()) {
        EXPECT_EQ(line.component, "Component");
        EXPECT_EQ(line.function, "trace");
        lines.emplace_back(line.level, line.text);
    }
    EXPECT_THAT(lines, testing::ElementsAre(std::tuple(6000, "a warning"),
                           std::tuple(4000, "information more"), std::tuple(3000, "verbose")));
    EXPECT_TRUE(capture.log().empty());
}

TEST_F(MessagesTest, TheObserverSeesTraceMessagesAsTheyWereSent)
{
    std::vector<std::tuple<CMPILevel, std::string, std::string, std::string>> seen;
    broker.setTraceObserver([&](const Host::TraceMessage& message) {
        seen.emplace_back(message.level, message.component, message.text, message.string);
    });
    EXPECT_EQ(CMTraceMessage(mb, CMPI_LEV_WARNING, "Component", "a   text.", string("more")).rc,
        CMPI_RC_OK);
    const CMPIString handleless{nullptr, &Host::String::functions};
    EXPECT_EQ(CMTraceMessage(mb, CMPI_LEV_INFO, nullptr, nullptr, &handleless).rc, CMPI_RC_OK);
    EXPECT_THAT(
        seen, testing::ElementsAre(std::tuple(CMPI_LEV_WARNING, "Component", "a   text.", "more"),
                  std::tuple(CMPI_LEV_INFO, "", "", "")));
}

TEST_F(MessagesTest, AFailingObserverIsAStatus)
{
    broker.setTraceObserver(
        [](const Host::TraceMessage&) { throw std::runtime_error("observer"); });
    EXPECT_EQ(CMTraceMessage(mb, CMPI_LEV_INFO, "C", "T", nullptr).rc, CMPI_RC_ERR_FAILED);
}

TEST_F(MessagesTest, AMessageIsItsDefaultText)
{
    EXPECT_EQ(textOf(mb->eft->getMessage(mb, "ID1", "failed: $0", &rc, 2, CMPI_chars, "x")),
        "failed: $0");
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(mb->eft->getMessage2(mb, "ID1", nullptr, "text", &rc, 0)), "text");
    CMPIMsgFileHandle file = nullptr;
    EXPECT_EQ(CMOpenMessageFile(mb, "file", &file).rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(CMCloseMessageFile(mb, file).rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

} // namespace HostTests
