// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A sink that keeps the answer in order.

#pragma once

#include "host/broker/ResultSink.h"
#include "host/broker/Value.h"

#include <cstddef>
#include <vector>

namespace Host {

class Enumeration;

// What it holds shows each object as it was when it was delivered, and lives as long as the
// request.
class CollectedResult : public ResultSink {
public:
    void instance(const Instance& instance) override;
    void path(const ObjectPath& path) override;
    void data(const Value& value) override;
    void error(const Error& error) override;
    void done() override { isDone_ = true; }
    void refused(CMPIrc) override { ++refused_; }

    const std::vector<const Instance*>& instances() const noexcept { return instances_; }
    const std::vector<const ObjectPath*>& paths() const noexcept { return paths_; }
    const std::vector<Value>& values() const noexcept { return values_; }
    const std::vector<const Error*>& errors() const noexcept { return errors_; }
    bool isDone() const noexcept { return isDone_; }
    // How many deliveries were refused.
    std::size_t refused() const noexcept { return refused_; }

    // The answer of an up-call: the paths, or the instances. In the arena of this thread's
    // request, which must be the one they live in.
    Enumeration& pathEnumeration() const;
    Enumeration& instanceEnumeration() const;

private:
    std::vector<const Instance*> instances_;
    std::vector<const ObjectPath*> paths_;
    std::vector<Value> values_;
    std::vector<const Error*> errors_;
    bool isDone_ = false;
    std::size_t refused_ = 0;
};

} // namespace Host
