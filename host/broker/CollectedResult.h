// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The objects that a provider delivered in a call, in order.

#pragma once

#include <cstddef>
#include <functional>
#include <string_view>
#include <vector>

namespace Host {

class Instance;
class ObjectPath;

// Holds a copy of each object as it was delivered. The objects live as long as the request.
class CollectedResult {
public:
    const std::vector<const Instance*>& instances() const noexcept { return instances_; }
    const std::vector<const ObjectPath*>& paths() const noexcept { return paths_; }
    // Returns whether the provider closed its result.
    bool isDone() const noexcept { return isDone_; }
    // Returns how many deliveries were refused: of null, of objects without a handle, and after the
    // end.
    std::size_t refused() const noexcept { return refused_; }

    bool isEmpty() const noexcept { return instances_.empty() && paths_.empty(); }

    void add(const Instance& instance) { instances_.push_back(&instance); }
    void add(const ObjectPath& path) { paths_.push_back(&path); }
    void addRefusal() noexcept { ++refused_; }
    void close() noexcept { isDone_ = true; }
    // Adds the objects and refusals of the other one.
    void append(const CollectedResult& other);
    // Removes the objects for whose namespace and class the predicate is false.
    void keepOnly(const std::function<bool(std::string_view nameSpace, std::string_view className)>&
            isWanted);

private:
    std::vector<const Instance*> instances_;
    std::vector<const ObjectPath*> paths_;
    bool isDone_ = false;
    std::size_t refused_ = 0;
};

} // namespace Host
