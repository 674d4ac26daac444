// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Objects and the associations between them.

#pragma once

#include <cstddef>
#include <limits>
#include <string>
#include <unordered_map>
#include <vector>

namespace Host {
class Instance;
class ObjectPath;
} // namespace Host

namespace Tools {

// Refers to paths and instances that must outlive it.
class AssociationGraph {
public:
    using Index = std::size_t;

    // From an object to another one, which the association refers to by its role.
    struct Link {
        Index target;
        std::string role;
        std::string associationClass;

        bool operator==(const Link&) const = default;
    };

    static constexpr std::size_t unreachable = std::numeric_limits<std::size_t>::max();

    // Links the objects that an association instance refers to, each to every other.
    void add(const Host::Instance& association);

    // Returns the object's index. Adds the object when no association refers to it.
    Index indexOf(const Host::ObjectPath& path);

    const Host::ObjectPath& path(Index object) const { return *objects_[object].path; }
    const std::vector<Link>& links(Index object) const { return objects_[object].links; }

    // Returns, for each object, the least number of links to it from the given one.
    std::vector<std::size_t> distancesFrom(Index object) const;

private:
    struct Object {
        const Host::ObjectPath* path;
        std::vector<Link> links;
    };

    std::vector<Object> objects_;
    std::unordered_map<std::string, Index> places_; // by identity
};

} // namespace Tools
