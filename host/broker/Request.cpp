// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Request.h"

#include "host/broker/Broker.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"

namespace Host {

namespace {

void addText(Context& context, Arena& arena, const char* name, std::string_view text)
{
    if (!text.empty())
        context.add(name, Value::text(arena, text));
}

} // namespace

Request::Request(const Broker& broker, const RequestInfo& info)
    : broker_(broker), own_(Arena::current() == nullptr ? std::make_shared<Arena>() : nullptr),
      arena_(own_ ? *own_ : *Arena::current())
{
    Arena* const before = Arena::makeCurrent(&arena_);
    try {
        context_.add(CMPIInvocationFlags, Value::integer(CMPI_uint32, info.flags));
        addText(context_, arena_, CMPIInitNameSpace, info.nameSpace);
        addText(context_, arena_, CMPIPrincipal, info.principal);
        addText(context_, arena_, CMPIAcceptLanguage, info.acceptLanguage);
    } catch (...) {
        Arena::makeCurrent(before);
        throw;
    }
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
