// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/AssociationGraph.h"

#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/String.h"
#include "tools/cim/ObjectNames.h"

#include <deque>

namespace Tools {

void AssociationGraph::add(const Host::Instance& association)
{
    struct End {
        Index object;
        std::string role;
    };
    std::vector<End> ends;
    for (const Host::NamedValue& property : association.properties())
        if (const Host::ObjectPath* const target = property.value.path())
            ends.push_back({indexOf(*target), std::string(*property.name->text())});
    for (std::size_t from = 0; from < ends.size(); ++from)
        for (std::size_t to = 0; to < ends.size(); ++to)
            if (from != to)
                objects_[ends[from].object].links.push_back(
                    {ends[to].object, ends[to].role, std::string(association.className())});
}

AssociationGraph::Index AssociationGraph::indexOf(const Host::ObjectPath& path)
{
    const auto [place, isNew] = places_.try_emplace(identityOf(path), objects_.size());
    if (isNew)
        objects_.push_back({&path, {}});
    return place->second;
}

std::vector<std::size_t> AssociationGraph::distancesFrom(Index object) const
{
    std::vector<std::size_t> distances(objects_.size(), unreachable);
    std::deque<Index> waiting = {object};
    distances[object] = 0;
    for (; !waiting.empty(); waiting.pop_front()) {
        const Index current = waiting.front();
        for (const Link& link : objects_[current].links) {
            if (distances[link.target] != unreachable)
                continue;
            distances[link.target] = distances[current] + 1;
            waiting.push_back(link.target);
        }
    }
    return distances;
}

} // namespace Tools
