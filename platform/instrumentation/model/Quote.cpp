// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/model/Quote.h"

#include "platform/text/Escape.h"
#include "platform/text/Utf8.h"

namespace Vorn {

std::string excerpt(std::string_view text)
{
    constexpr std::size_t maximumBytes = 160;
    const std::string_view beginning = Text::cutAtCharacter(text, maximumBytes);
    return Text::escapeControls(Text::toValidUtf8(beginning)) +
           (beginning.size() < text.size() ? "..." : "");
}

std::string quote(std::string_view text)
{
    return '"' + excerpt(text) + '"';
}

} // namespace Vorn
