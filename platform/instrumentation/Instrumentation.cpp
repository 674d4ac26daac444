// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/Instrumentation.h"

#include "platform/instrumentation/FailureLog.h"
#include "platform/instrumentation/OpenSource.h"
#include "platform/instrumentation/Source.h"
#include "platform/text/Escape.h"

#include <cstdlib>
#include <exception>
#include <optional>
#include <span>
#include <utility>

namespace Vorn {

using NodeLexicon::NodeType;
using NodeLexicon::Properties;

namespace {

std::string sourceListFromEnvironment()
{
    const char* value = secure_getenv("VORN_INSTRUMENTATION");
    return value == nullptr || *value == '\0' ? Instrumentation::defaultSources : value;
}

// Runs one step of using a source and records whether it failed.
template <typename Action>
auto attempt(const std::string& entry, SourceStep step, const Action& action)
{
    try {
        auto result = action();
        FailureLog::instance().succeeded(entry, step);
        return result;
    } catch (const std::exception& error) {
        FailureLog::instance().failed(entry, step, error.what());
        throw;
    }
}

const std::optional<double>& numberOf(const NodeReading& reading, Properties property)
{
    switch (property) {
    case Properties::Reading:
        return reading.reading;
    case Properties::UpperCritical:
        return reading.upperCritical;
    case Properties::UpperNonCritical:
        return reading.upperNonCritical;
    case Properties::LowerCritical:
        return reading.lowerCritical;
    case Properties::LowerNonCritical:
        return reading.lowerNonCritical;
    case Properties::UpperFatal:
        return reading.upperFatal;
    case Properties::LowerFatal:
        return reading.lowerFatal;
    case Properties::BaseUnits:
    case Properties::PossibleStates:
        break;
    }
    static constexpr std::optional<double> none;
    return none;
}

template <typename Value>
bool store(const std::optional<Value>& from, Value& to)
{
    if (from)
        to = *from;
    return from.has_value();
}

} // namespace

struct Instrumentation::State {
    struct OpenSource {
        std::string entry;
        std::unique_ptr<Source> source;
        std::span<const Node> nodes; // of the selected type
    };

    std::vector<OpenSource> sources;
    std::exception_ptr openFailure; // of the first source that could not be opened
    NodeType type{};
    std::size_t place = 0;                // the source of the node under the cursor
    std::size_t index = 0;                // the node's index among those of its source
    const NodeReading* reading = nullptr; // of the node under the cursor, once it was read

    State();
    void select(NodeType selected);
    void advance();
    void passFinishedSources();
    static bool haveNodes(const std::vector<OpenSource*>& listed);
    bool isOnNode() const { return place < sources.size(); }
    const Node& node() const { return sources.at(place).nodes[index]; }
    const NodeReading& visit() { return reading != nullptr ? *reading : readNode(); }
    const NodeReading& readNode();
};

Instrumentation::State::State()
{
    const std::string list = sourceListFromEnvironment();
    const auto entries =
        attempt(list, {SourceStep::Stage::Configuring, {}}, [&] { return parseSourceList(list); });
    for (const SourceEntry& entry : entries) {
        try {
            auto source = attempt(
                entry.text, {SourceStep::Stage::Opening, {}}, [&] { return openSource(entry); });
            sources.push_back({entry.text, std::move(source), {}});
        } catch (const std::exception&) {
            if (!openFailure)
                openFailure = std::current_exception();
        }
    }
    if (sources.empty() && openFailure)
        std::rethrow_exception(openFailure);
    place = sources.size();
}

void Instrumentation::State::select(NodeType selected)
{
    place = sources.size(); // stays past the last node where a source fails
    reading = nullptr;
    type = selected;
    std::exception_ptr failure = openFailure;
    std::vector<OpenSource*> listed;
    for (OpenSource& open : sources) {
        open.nodes = {};
        try {
            open.nodes = *attempt(open.entry, {SourceStep::Stage::Listing, selected},
                [&] { return &open.source->nodes(selected); });
            listed.push_back(&open);
        } catch (const std::exception&) {
            if (!failure)
                failure = std::current_exception();
        }
    }
    if (failure && !haveNodes(listed))
        std::rethrow_exception(failure);
    place = 0;
    index = 0;
    passFinishedSources();
}

// Returns whether one of the sources has nodes of any type.
bool Instrumentation::State::haveNodes(const std::vector<OpenSource*>& listed)
{
    for (const OpenSource* const open : listed)
        if (!open->nodes.empty())
            return true;
    for (const OpenSource* const open : listed)
        for (const NodeType each : {NodeType::Temperature, NodeType::Voltage, NodeType::Tachometer})
            try {
                if (!open->source->nodes(each).empty())
                    return true;
            } catch (const std::exception&) { // it has failed since
            }
    return false;
}

void Instrumentation::State::advance()
{
    reading = nullptr;
    ++index;
    passFinishedSources();
}

void Instrumentation::State::passFinishedSources()
{
    for (; isOnNode() && index >= sources[place].nodes.size(); ++place, index = 0)
        // Only an iteration that reaches the end proves that every node can be read.
        FailureLog::instance().succeeded(sources[place].entry, {SourceStep::Stage::Reading, type});
}

const NodeReading& Instrumentation::State::readNode()
{
    const Node& visited = node();
    const OpenSource& open = sources[place];
    try {
        reading = &open.source->read(visited);
        return *reading;
    } catch (const std::exception& error) {
        FailureLog::instance().failed(open.entry, {SourceStep::Stage::Reading, type}, error.what());
        throw;
    }
}

Instrumentation::Instrumentation() : state_(std::make_unique<State>()) {}

Instrumentation::~Instrumentation() = default;

void Instrumentation::selectNode(NodeType type)
{
    state_->select(type);
}

Instrumentation::operator bool() const noexcept
{
    return state_->isOnNode();
}

Instrumentation& Instrumentation::operator++()
{
    state_->advance();
    return *this;
}

std::string Instrumentation::getPathToNode() const
{
    return state_->node().path;
}

std::string Instrumentation::convertPathToString(const std::string& path) const
{
    return Text::toOneLine(path);
}

std::string Instrumentation::getNodeDescription() const
{
    return state_->node().description;
}

unsigned Instrumentation::getSensorType() const
{
    return state_->node().sensorType;
}

unsigned Instrumentation::getNodeStatus()
{
    return state_->visit().status;
}

bool Instrumentation::getProperty(Properties property, double& value)
{
    return store(numberOf(state_->visit(), property), value);
}

bool Instrumentation::getProperty(Properties property, unsigned& value)
{
    return property == Properties::BaseUnits && store(state_->visit().baseUnits, value);
}

bool Instrumentation::getProperty(Properties property, std::vector<unsigned>& value)
{
    return property == Properties::PossibleStates && store(state_->visit().possibleStates, value);
}

} // namespace Vorn
