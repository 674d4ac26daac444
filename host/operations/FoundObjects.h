// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The objects that an operation has found, before they are written.

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

// The name of a class, for answers that hold no more of it.
struct ClassName {
    std::string_view text;
};

// Classes, their names and qualifiers are the repository's.
using FoundObject = std::variant<const Instance*, const ObjectPath*, const ClassDeclaration*,
    ClassName, const QualifierDeclaration*, Value>;

// A run of objects, and a share in the memory they live in. That is given back as a whole, when
// the last run of it goes; it makes no difference on which thread.
class FoundObjects {
public:
    FoundObjects() : FoundObjects(nullptr) {}
    // The arena may be null when no object lives in one.
    explicit FoundObjects(std::shared_ptr<const Arena> arena);

    // REQUIRES: nothing was taken yet.
    void add(const FoundObject& object);
    // The instances of the result and its paths.
    void add(const CollectedResult& result);

    std::size_t size() const noexcept { return end_ - begin_; }
    const FoundObject& operator[](std::size_t position) const
    {
        return store_->objects[begin_ + position];
    }

    // The first ones, which are in here no more; fewer if there are not as many.
    FoundObjects takeFirst(std::size_t count);

    // How many objects the memory holds, with those that were taken.
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
