// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A machine whose nodes and failures a test defines. It is the source of Vorn::Instrumentation
// during its lifetime.

#pragma once

#include "platform/instrumentation/Source.h"
#include "tests/support/Environment.h"
#include "tests/support/TestSources.h"

#include <map>
#include <memory>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace Testing {

struct ScriptedNode {
    Vorn::NodeLexicon::NodeType type = Vorn::NodeLexicon::NodeType::Temperature;
    std::string path;
    std::string description;
    Vorn::NodeReading reading = {};
    std::optional<unsigned> sensorType = std::nullopt; // the type's own number otherwise
    bool failsWhenRead = false;
};

class ScriptedMachine {
public:
    explicit ScriptedMachine(std::vector<ScriptedNode> nodes = {})
        : script_(std::make_shared<Script>(Script{std::move(nodes), {}, {}})),
          environment_("VORN_INSTRUMENTATION", "scripted")
    {
        provideSource("scripted", [script = script_]() -> std::unique_ptr<Vorn::Source> {
            if (script->constructionFails)
                throw std::runtime_error("scripted: construction");
            return std::make_unique<ScriptedSource>(script);
        });
    }

    void failConstruction(bool fails = true) { script_->constructionFails = fails; }
    void failSelection(Vorn::NodeLexicon::NodeType type) { script_->selectionFails[type] = true; }

private:
    struct Script {
        std::vector<ScriptedNode> nodes;
        bool constructionFails;
        std::map<Vorn::NodeLexicon::NodeType, bool> selectionFails;
    };

    class ScriptedSource : public Vorn::Source {
    public:
        explicit ScriptedSource(std::shared_ptr<const Script> script) : script_(std::move(script))
        {
        }

        const std::vector<Vorn::Node>& nodes(Vorn::NodeLexicon::NodeType type) override
        {
            if (script_->selectionFails.contains(type))
                throw std::runtime_error("scripted: selection");
            nodes_.clear();
            for (std::size_t i = 0; i < script_->nodes.size(); ++i) {
                const ScriptedNode& node = script_->nodes[i];
                if (node.type == type)
                    nodes_.push_back({node.path, node.description,
                        node.sensorType.value_or(static_cast<unsigned>(type)), i});
            }
            return nodes_;
        }

        const Vorn::NodeReading& read(const Vorn::Node& node) override
        {
            const ScriptedNode& scripted = script_->nodes.at(node.token);
            if (scripted.failsWhenRead)
                throw std::runtime_error("scripted: reading");
            return scripted.reading;
        }

    private:
        std::shared_ptr<const Script> script_;
        std::vector<Vorn::Node> nodes_;
    };

    std::shared_ptr<Script> script_;
    EnvironmentVariable environment_;
};

} // namespace Testing
