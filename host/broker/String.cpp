// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/String.h"

#include "host/broker/Slot.h"

namespace Host {

String& String::make(Arena& arena, std::string_view text)
{
    return arena.make<String>(arena.text(text));
}

String& String::makeWithoutText(Arena& arena)
{
    return arena.make<String>(std::string_view{});
}

const CMPIStringFT String::functions = {
    .ftVersion = CMPIVersion200,
    .release = notOffered,
    .clone = notOffered,
    .getCharPtr = slot<&String::characters>,
};

} // namespace Host
