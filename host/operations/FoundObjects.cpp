// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/FoundObjects.h"

#include "host/broker/CollectedResult.h"

#include <algorithm>
#include <utility>

namespace Host {

FoundObjects::FoundObjects(std::shared_ptr<const Arena> arena)
    : store_(std::make_shared<Store>(Store{std::move(arena), {}}))
{
}

void FoundObjects::add(const FoundObject& object)
{
    store_->objects.push_back(object);
    ++end_;
}

void FoundObjects::add(const CollectedResult& result)
{
    store_->objects.reserve(size() + result.instances().size() + result.paths().size());
    for (const Instance* const instance : result.instances())
        add(FoundObject(instance));
    for (const ObjectPath* const path : result.paths())
        add(FoundObject(path));
}

FoundObjects FoundObjects::takeFirst(std::size_t count)
{
    FoundObjects first = *this;
    first.end_ = begin_ += std::min(count, size());
    return first;
}

} // namespace Host
