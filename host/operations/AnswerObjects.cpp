// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/AnswerObjects.h"

#include "host/broker/CollectedResult.h"

#include <algorithm>
#include <utility>

namespace Host {

AnswerObjects::AnswerObjects(std::shared_ptr<const Arena> arena)
    : store_(std::make_shared<Store>(Store{std::move(arena), {}}))
{
}

void AnswerObjects::add(const AnswerObject& object)
{
    store_->objects.push_back(object);
    ++end_;
}

void AnswerObjects::add(const CollectedResult& result)
{
    store_->objects.reserve(size() + result.instances().size() + result.paths().size());
    for (const Instance* const instance : result.instances())
        add(AnswerObject(instance));
    for (const ObjectPath* const path : result.paths())
        add(AnswerObject(path));
}

AnswerObjects AnswerObjects::takeFirst(std::size_t count)
{
    AnswerObjects first = *this;
    first.end_ = begin_ += std::min(count, size());
    return first;
}

} // namespace Host
