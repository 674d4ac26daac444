// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The objects that an operation returns, before they are written.

#pragma once

#include "host/broker/Value.h"

#include <cstddef>
#include <memory>
#include <string_view>
#include <variant>
#include <vector>

namespace Host {

class Arena;
class CollectedResult;
class Instance;
class ObjectPath;
struct ClassDeclaration;
struct QualifierDeclaration;

// The name of a class, for operations that return no more of it.
struct ClassName {
    std::string_view text;
};

// Classes, their names and qualifiers are the repository's.
using FoundObject = std::variant<const Instance*, const ObjectPath*, const ClassDeclaration*,
    ClassName, const QualifierDeclaration*, Value>;

// A range of objects that shares the memory they live in with other ranges of it. The memory is
// freed as a whole with the last of them, on whichever thread.
class FoundObjects {
public:
    FoundObjects() : FoundObjects(nullptr) {}
    // The arena may be null when no object lives in one.
    explicit FoundObjects(std::shared_ptr<const Arena> arena);

    // REQUIRES: takeFirst() was not called.
    void add(const FoundObject& object);
    // Adds the instances and paths of the result.
    void add(const CollectedResult& result);

    std::size_t size() const noexcept { return end_ - begin_; }
    const FoundObject& operator[](std::size_t position) const
    {
        return store_->objects[begin_ + position];
    }

    // Removes and returns that many objects from the beginning, or all if there are fewer.
    FoundObjects takeFirst(std::size_t count);

    // Returns the number of objects in the memory, with those that were taken.
    std::size_t heldObjects() const noexcept { return store_->objects.size(); }

private:
    struct Store {
        std::shared_ptr<const Arena> arena;
        std::vector<FoundObject> objects;
    };

    std::shared_ptr<Store> store_;
    std::size_t begin_ = 0;
    std::size_t end_ = 0;
};

} // namespace Host
