// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Arena.h"

#include "host/broker/Refusal.h"
#include "host/broker/String.h"

#include <cstring>
#include <utility>

namespace Host {

std::string_view Arena::text(std::string_view characters)
{
    char* const copy = static_cast<char*>(memory_.allocate(characters.size() + 1, 1));
    if (!characters.empty())
        std::memcpy(copy, characters.data(), characters.size());
    copy[characters.size()] = '\0';
    return {copy, characters.size()};
}

const String& Arena::name(std::string_view characters)
{
    // Objects of a class mostly have the same names in the same order.
    Name* found = lastName_ == nullptr ? nullptr : lastName_->next;
    if (found == nullptr || found->string->text() != characters) {
        found = &findName(characters);
        if (lastName_ != nullptr)
            lastName_->next = found;
    }
    lastName_ = found;
    return *found->string;
}

Arena::Name& Arena::findName(std::string_view characters)
{
    if (const auto known = names_.find(characters); known != names_.end())
        return known->second;
    const String& made = String::make(*this, characters);
    return names_.emplace(*made.text(), Name{&made}).first->second;
}

void Arena::refuse()
{
    throw Refusal(CMPI_RC_ERR_FAILED, "no request is active on this thread");
}

Arena* Arena::makeCurrent(Arena* arena) noexcept
{
    return std::exchange(current_, arena);
}

} // namespace Host
