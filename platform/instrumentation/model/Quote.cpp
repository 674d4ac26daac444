// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/model/Quote.h"

#include "platform/instrumentation/Utf8.h"

namespace Vorn {

namespace {

constexpr std::size_t mostBytes = 160;

bool isContinuation(char byte)
{
    return (static_cast<unsigned char>(byte) & 0xC0U) == 0x80U;
}

} // namespace

std::string excerpt(std::string_view text)
{
    if (text.size() <= mostBytes)
        return escapeControls(toValidUtf8(text));
    std::size_t end = mostBytes;
    while (end > 0 && isContinuation(text[end]))
        --end;
    return escapeControls(toValidUtf8(text.substr(0, end))) + "...";
}

std::string quote(std::string_view text)
{
    return '"' + excerpt(text) + '"';
}

} // namespace Vorn
