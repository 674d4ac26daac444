// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/String.h"

#include "host/broker/Slot.h"

namespace Host {

String& String::make(Arena& arena, std::string_view text)
{
    return arena.make<String>(arena, arena.text(text));
}

String& String::makeWithoutText(Arena& arena)
{
    return arena.make<String>(arena, std::string_view{});
}

String& String::copiedTo(Arena& arena) const
{
    if (home_ == &arena)
        return const_cast<String&>(*this);
    return text_.data() == nullptr ? makeWithoutText(arena) : make(arena, text_);
}

const CMPIStringFT String::functions = {
    .ftVersion = CMPIVersion200,
    .release = slot<&String::release>,
    .clone = slot<&String::cloned>,
    .getCharPtr = slot<&String::characters>,
};

} // namespace Host
