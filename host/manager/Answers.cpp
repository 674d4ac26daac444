// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/Answers.h"

#include "host/broker/CollectedResult.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"
#include "platform/logging/RynLogger.h"

#include <optional>

namespace Host {

namespace {

constexpr int warningLevel = 7000;

// That a provider does not offer an operation is no news.
void report(const ProviderRegistration& provider, const Refusal& refusal)
{
    if (refusal.code() == CMPI_RC_ERR_NOT_SUPPORTED)
        return;
    RynLog::RynLogger::logLevelMessage("gatherAnswers", "Answers", __LINE__, "Manager",
        warningLevel, nullptr, 0, 0,
        provider.providerName + " answers code " + std::to_string(refusal.code()) + ": " +
            refusal.what());
}

// False when there is nothing.
bool passOn(const CollectedResult& answer, ResultSink& sink)
{
    for (const Instance* const instance : answer.instances())
        sink.instance(*instance);
    for (const ObjectPath* const path : answer.paths())
        sink.path(*path);
    for (const Value& value : answer.values())
        sink.data(value);
    for (const Error* const error : answer.errors())
        sink.error(*error);
    for (std::size_t i = 0; i < answer.refused(); ++i)
        sink.refused(CMPI_RC_ERR_FAILED);
    return !answer.instances().empty() || !answer.paths().empty() || !answer.values().empty();
}

void gatherFromSeveral(
    const Routing::Registrations& providers, ResultSink& sink, const AskProvider& ask)
{
    std::optional<Refusal> firstFailure;
    bool isAnythingFound = false;
    for (const ProviderRegistration* const provider : providers) {
        CollectedResult answer;
        try {
            ask(*provider, answer);
        } catch (const Refusal& refusal) {
            report(*provider, refusal);
            if (!firstFailure)
                firstFailure = refusal;
            continue;
        }
        if (passOn(answer, sink))
            isAnythingFound = true;
    }
    if (firstFailure && !isAnythingFound)
        throw Refusal(*firstFailure);
}

} // namespace

void AnswerOfClass::instance(const Instance& instance)
{
    if (passes(instance.className()))
        OpenAnswer::instance(instance);
}

void AnswerOfClass::path(const ObjectPath& path)
{
    if (passes(path.className()))
        OpenAnswer::path(path);
}

bool AnswerOfClass::passes(std::string_view className) const
{
    return className_ == nullptr || routing_.isA(nameSpace_, className, className_);
}

void gatherAnswers(
    const Routing::Registrations& providers, ResultSink& sink, const AskProvider& ask)
{
    if (providers.size() == 1) {
        OpenAnswer answer(sink);
        ask(*providers.front(), answer);
    } else {
        gatherFromSeveral(providers, sink, ask);
    }
    sink.done();
}

} // namespace Host
