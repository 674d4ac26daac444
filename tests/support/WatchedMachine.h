// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A machine with one node of each type that calls a function of the test when a node is read and
// counts the cursors. It is the source of Vorn::Instrumentation during its lifetime.

#pragma once

#include "platform/instrumentation/Source.h"
#include "tests/support/Environment.h"
#include "tests/support/TestSources.h"

#include <algorithm>
#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace Testing {

// An exception that is not derived from std::exception.
struct StrangeException {};

class WatchedMachine {
public:
    explicit WatchedMachine(std::function<void()> whenRead)
        : watch_(std::make_shared<Watch>(Watch{std::move(whenRead), 0, 0, 0})),
          environment_("VORN_INSTRUMENTATION", "watched")
    {
        provideSource(
            "watched", [watch = watch_] { return std::make_unique<WatchedSource>(watch); });
    }

    unsigned cursorsMade() const { return watch_->made; }
    unsigned cursorsLeft() const { return watch_->left; }
    unsigned mostCursorsAtOnce() const { return watch_->most; }

private:
    struct Watch {
        std::function<void()> whenRead;
        unsigned made;
        unsigned left;
        unsigned most;
    };

    // Each cursor has a source of its own.
    class WatchedSource : public Vorn::Source {
    public:
        explicit WatchedSource(std::shared_ptr<Watch> watch) : watch_(std::move(watch))
        {
            ++watch_->made;
            watch_->most = std::max(watch_->most, ++watch_->left);
        }
        ~WatchedSource() override { --watch_->left; }
        WatchedSource(const WatchedSource&) = delete;
        WatchedSource& operator=(const WatchedSource&) = delete;

        const std::vector<Vorn::Node>& nodes(Vorn::NodeLexicon::NodeType type) override
        {
            nodes_ = {{"/node", "node", static_cast<unsigned>(type), 0}};
            return nodes_;
        }

        const Vorn::NodeReading& read(const Vorn::Node&) override
        {
            watch_->whenRead();
            return reading_;
        }

    private:
        std::shared_ptr<Watch> watch_;
        std::vector<Vorn::Node> nodes_;
        Vorn::NodeReading reading_;
    };

    std::shared_ptr<Watch> watch_;
    EnvironmentVariable environment_;
};

} // namespace Testing
