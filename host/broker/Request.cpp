// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Request.h"

#include "host/broker/Broker.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"

namespace Host {

Request::Request(const Broker& broker)
    : broker_(broker), own_(Arena::current() == nullptr ? std::make_shared<Arena>() : nullptr),
      arena_(own_ ? *own_ : *Arena::current())
{
    Arena::makeCurrent(&arena_);
}

Request::~Request()
{
    if (own_)
        Arena::makeCurrent(nullptr);
}

ObjectPath& Request::makePath(std::string_view nameSpace, std::string_view className) const
{
    return ObjectPath::make(arena_, nameSpace, className);
}

Instance& Request::makeInstance(const ObjectPath& path) const
{
    return Instance::make(arena_, path, broker_.classInformation());
}

} // namespace Host
