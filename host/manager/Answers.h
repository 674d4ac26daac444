// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The answers of one or several providers as one.

#pragma once

#include "host/broker/ResultSink.h"
#include "host/manager/Routing.h"

#include <functional>
#include <string>
#include <string_view>

namespace Host {

// Passes everything on but the end: the operation's end comes when all providers have
// answered, whether they closed their results or not.
class OpenAnswer : public ResultSink {
public:
    // The sink must outlive it.
    explicit OpenAnswer(ResultSink& sink) : sink_(sink) {}

    void instance(const Instance& instance) override { sink_.instance(instance); }
    void path(const ObjectPath& path) override { sink_.path(path); }
    void data(const Value& value) override { sink_.data(value); }
    void error(const Error& error) override { sink_.error(error); }
    void done() override {}
    void refused(CMPIrc code) override { sink_.refused(code); }

private:
    ResultSink& sink_;
};

// The same, but for objects that are not of the class or below it.
class AnswerOfClass : public OpenAnswer {
public:
    // All must outlive it. A null class lets everything pass.
    AnswerOfClass(
        ResultSink& sink, const Routing& routing, std::string_view nameSpace, const char* className)
        : OpenAnswer(sink), routing_(routing), nameSpace_(nameSpace), className_(className)
    {
    }

    void instance(const Instance& instance) override;
    void path(const ObjectPath& path) override;

private:
    bool passes(std::string_view className) const;

    const Routing& routing_;
    std::string_view nameSpace_;
    const char* className_;
};

using AskProvider = std::function<void(const ProviderRegistration&, ResultSink&)>;

// Asks the providers in turn and ends the answer; without providers it is empty.
//
// A single provider's results go to the sink as they come. When it fails after some of them,
// its Refusal comes out of here and the sink must forget what it has got.
//
// Of several providers each answer is passed on when it is complete. What one of them fails to
// answer takes nothing away from what others have found: the failure is written to the log,
// with its reason. Only where nothing at all was found the first failure is the answer, since
// "there is nothing" would not be true.
void gatherAnswers(
    const Routing::Registrations& providers, ResultSink& sink, const AskProvider& ask);

} // namespace Host
