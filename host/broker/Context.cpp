// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Context.h"

#include "host/broker/Slot.h"

namespace Host {

void Context::add(std::string_view name, const Value& value)
{
    entries_.set(memory(), name, value);
}

Context& Context::copiedTo(Arena& arena) const
{
    Context& copy = arena.make<Context>(arena);
    copy.entries_ = entries_.copiedTo(arena, home_ == &arena);
    return copy;
}

CMPIData Context::getEntry(const char* name) const
{
    return entries_.get(name, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

CMPIData Context::getEntryAt(CMPICount position, CMPIString** name) const
{
    return entries_.getAt(position, name);
}

void Context::addEntry(const char* name, const CMPIValue* value, CMPIType type)
{
    add(requiredText(name, "the entry's name"), Value::from(memory(), value, type));
}

const CMPIContextFT Context::functions = {
    .ftVersion = CMPIVersion200,
    .release = slot<&Context::release>,
    .clone = slot<&Context::cloned>,
    .getEntry = slot<&Context::getEntry>,
    .getEntryAt = slot<&Context::getEntryAt>,
    .getEntryCount = slot<+[](const Context& context) { return context.entries_.size(); }>,
    .addEntry = slot<&Context::addEntry>,
};

} // namespace Host
