// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/RequestCounts.h"
#include "host/cimxml/Message.h"
#include "host/cimxml/OperationTable.h"
#include "host/cimxml/RequestError.h"
#include "tests/support/CimCall.h"
#include "tests/tools/Scrape.h"

#include <gtest/gtest.h>

#include <functional>
#include <stdexcept>

namespace {

using Host::CimXml::Caller;
using Host::CimXml::Message;

class EmptyResponse : public Host::CimXml::Response {
public:
    bool append(std::string&) override { return false; }
    std::size_t heldObjects() const noexcept override { return 0; }
};

class ScriptedHandler : public Host::CimXml::OperationHandler {
public:
    std::unique_ptr<Host::CimXml::Response> answer(const Message&, const Caller&) override
    {
        if (work)
            work();
        return std::make_unique<EmptyResponse>();
    }

    std::function<void()> work;
};

class RequestCountsTest : public testing::Test {
protected:
    // Returns the counts of an operation by its result.
    std::map<std::string, double> of(const std::string& operation) const
    {
        Tools::Exposition exposition(Tools::ExpositionForm::text);
        counts_.addTo(exposition);
        std::map<std::string, double> values;
        for (const Testing::Series& each : Testing::seriesIn(std::move(exposition).finish()))
            if (each.labels.at("operation") == operation)
                values[each.labels.at("result")] = each.value;
        return values;
    }

    void ask(const std::string& operation)
    {
        counts_.answer(Message(Testing::cimCall(operation), 64), {});
    }

    ScriptedHandler handler_;
    Tools::RequestCounts counts_{handler_};
};

TEST_F(RequestCountsTest, EachOfferedOperationBeginsWithZero)
{
    const std::map<std::string, double> zero{{"ok", 0}};
    for (const auto& form : Host::CimXml::offeredOperations())
        EXPECT_EQ(of(std::string(form.name)), zero) << form.name;
    EXPECT_EQ(of("other").size(), 0U);
}

TEST_F(RequestCountsTest, ExceptionIsAnError)
{
    ask("EnumerateClasses");
    handler_.work = [] { throw std::runtime_error("broken"); };
    EXPECT_THROW(ask("EnumerateClasses"), std::runtime_error);
    EXPECT_EQ(of("EnumerateClasses"), (std::map<std::string, double>{{"ok", 1}, {"error", 1}}));
}

TEST_F(RequestCountsTest, MessageThatIsNoOperationDoesNotCount)
{
    handler_.work = [] {
        using namespace Host::CimXml;
        throw RequestError(Outcome::requestNotLooselyValid, 1, 0, "an element is missing");
    };
    EXPECT_THROW(ask("EnumerateClasses"), Host::CimXml::RequestError);
    EXPECT_EQ(of("EnumerateClasses"), (std::map<std::string, double>{{"ok", 0}}));
}

} // namespace
