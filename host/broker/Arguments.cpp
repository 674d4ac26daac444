// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Arguments.h"

#include "host/broker/Slot.h"

namespace Host {

Arguments& Arguments::make(Arena& arena)
{
    return arena.make<Arguments>(arena);
}

void Arguments::add(std::string_view name, const Value& value)
{
    values_.set(memory(), name, value);
}

Arguments& Arguments::copiedTo(Arena& arena) const
{
    Arguments& copy = make(arena);
    copy.values_ = values_.copiedTo(arena, home_ == &arena);
    return copy;
}

void Arguments::addArg(const char* name, const CMPIValue* value, CMPIType type)
{
    add(requiredText(name, "the argument's name"), Value::from(memory(), value, type));
}

CMPIData Arguments::getArg(const char* name) const
{
    return values_.get(name, CMPI_RC_ERR_NOT_FOUND);
}

CMPIData Arguments::getArgAt(CMPICount position, CMPIString** name) const
{
    return values_.getAt(position, name);
}

const CMPIArgsFT Arguments::functions = {
    .ftVersion = CMPIVersion200,
    .release = slot<&Arguments::release>,
    .clone = slot<&Arguments::cloned>,
    .addArg = slot<&Arguments::addArg>,
    .getArg = slot<&Arguments::getArg>,
    .getArgAt = slot<&Arguments::getArgAt>,
    .getArgCount = slot<+[](const Arguments& arguments) { return arguments.values_.size(); }>,
};

} // namespace Host
