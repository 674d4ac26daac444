// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Providers that OpenPegasus and sfcb unload, or whose process is killed, answer the next request
// as before. OpenPegasus has no setting for when idle providers are unloaded, which it does five to
// ten minutes after their last request: there, the test disables them and enables them again.

#include "tests/objectmanagers/Agents.h"
#include "tests/objectmanagers/Answer.h"
#include "tests/objectmanagers/InstalledManager.h"
#include "tests/support/WaitUntil.h"

#include <gtest/gtest.h>

#include <csignal>
#include <fstream>

namespace {

using namespace Testing;

class LifetimeTest : public testing::TestWithParam<const InstalledManager*> {
protected:
    void SetUp() override
    {
        manager_.reset();
        if (isSfcb())
            unloadSoon();
        manager_.startWithProviders(
            {{"RYNLOG_LOG", "off"}, {"VORN_INSTRUMENTATION", "model:" SENSOR_PROFILE_SOURCE_DIR
                                                             "/schema/demo-model.json"}});
        EXPECT_EQ(agents().size(), 0U);
        before_ = answers();
        for (const std::string& answer : before_)
            EXPECT_FALSE(answer.starts_with("error ") || answer.starts_with("0 ")) << answer;
        EXPECT_GT(agents().size(), 0U);
    }
    void TearDown() override { manager_.stop(); }

    bool isSfcb() const { return &manager_ == &InstalledManager::sfcb(); }

    // Makes sfcb unload a provider after three seconds without a request. It looks for such
    // providers every second; the defaults are 60 and 30 seconds.
    void unloadSoon() const
    {
        std::ofstream(manager_.folder() + "/etc/sfcb/sfcb.cfg", std::ios::app)
            << "providerTimeoutInterval: 3\nproviderSampleInterval: 1\n";
    }

    std::set<::pid_t> agents() const { return agentsBelow(manager_.folder()); }

    std::vector<std::string> answers() const
    {
        std::vector<std::string> texts;
        for (const std::string& name : servedClasses)
            texts.push_back(describe(ask({"ei", manager_.url(name)})));
        return texts;
    }

    // Disables or enables the providers in OpenPegasus.
    void forEachModule(const std::string& option) const
    {
        for (const std::string module : {"SensorProfileModule", "SensorProfileRegistrationModule",
                 "SensorProfileComputerSystemModule"})
            manager_.command("cimprovider", {option, "-m", module});
    }

    const InstalledManager& manager_ = *GetParam();
    std::vector<std::string> before_;
};

TEST_P(LifetimeTest, AnswersAgainAfterItsProcessWasKilled)
{
    for (const ::pid_t agent : agents())
        EXPECT_EQ(::kill(agent, SIGKILL), 0);
    ASSERT_TRUE(waitUntil([this] { return agents().empty(); }));
    EXPECT_EQ(answers(), before_);
}

TEST_P(LifetimeTest, AnswersAgainAfterItWasUnloaded)
{
    if (!isSfcb())
        forEachModule("-d");
    ASSERT_TRUE(waitUntil([this] { return agents().empty(); }));
    if (!isSfcb())
        forEachModule("-e");
    EXPECT_EQ(answers(), before_);
    EXPECT_GT(agents().size(), 0U);
}

INSTANTIATE_TEST_SUITE_P(ObjectManagers, LifetimeTest,
    testing::Values(&InstalledManager::openPegasus(), &InstalledManager::sfcb()),
    [](const auto& each) { return each.param->name(); });

} // namespace
