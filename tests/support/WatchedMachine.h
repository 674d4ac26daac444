// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A machine with one node of each type that runs what a test says when a node is read, and that
// counts the cursors over it. While it lives it is what Vorn::Instrumentation finds.

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

// Something thrown that no standard exception is a base of.
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

    // A cursor has one source of its own.
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

        std::vector<Vorn::Node> nodes(Vorn::NodeLexicon::NodeType type) override
        {
            return {{"/node", "node", static_cast<unsigned>(type), 0}};
        }

        Vorn::NodeReading read(const Vorn::Node&) override
        {
            watch_->whenRead();
            return {};
        }

    private:
        std::shared_ptr<Watch> watch_;
    };

    std::shared_ptr<Watch> watch_;
    EnvironmentVariable environment_;
};

} // namespace Testing
