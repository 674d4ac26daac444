// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/NamedValues.h"

#include "host/broker/Names.h"
#include "host/broker/Slot.h"
#include "host/broker/String.h"

namespace Host {

namespace {

// Returns one of 64 bits, the same for a name in any letter case.
std::uint64_t markOf(std::string_view name) noexcept
{
    if (name.empty())
        return 1;
    const std::size_t first = static_cast<unsigned char>(foldCase(name.front()));
    const std::size_t last = static_cast<unsigned char>(foldCase(name.back()));
    return std::uint64_t{1} << ((name.size() * 5 + first * 3 + last) % 64);
}

} // namespace

const NamedValue* NamedValues::find(std::string_view name) const noexcept
{
    if ((marks_ & markOf(name)) == 0)
        return nullptr;
    for (const NamedValue& element : elements_)
        if (equalNames(*element.name->text(), name))
            return &element;
    return nullptr;
}

void NamedValues::set(Arena& arena, std::string_view name, const Value& value)
{
    if (isShared_)
        retain(arena, [](const NamedValue&) { return true; });
    if (const NamedValue* const known = find(name))
        const_cast<NamedValue*>(known)->value = value; // an element of *this, which is not const
    else
        elements_.append(arena, {&arena.name(name), value});
    marks_ |= markOf(name);
}

NamedValues NamedValues::shared() const
{
    NamedValues copy;
    copy.elements_ = elements_;
    copy.marks_ = marks_;
    copy.isShared_ = isShared_ = true;
    return copy;
}

CMPIData NamedValues::get(const char* name, CMPIrc whenAbsent) const
{
    const std::string_view wanted = requiredText(name, "the name");
    if (const NamedValue* const found = find(wanted))
        return found->value.handOut();
    throw Refusal(whenAbsent, "there is no " + std::string(wanted));
}

CMPIData NamedValues::getAt(CMPICount position, CMPIString** name) const
{
    const NamedValue* const found = elements_.at(position);
    if (found == nullptr)
        throw Refusal(CMPI_RC_ERR_NO_SUCH_PROPERTY,
            "position " + std::to_string(position) + " of " + std::to_string(size()));
    if (name != nullptr)
        *name = found->name->handle();
    return found->value.handOut();
}

} // namespace Host
