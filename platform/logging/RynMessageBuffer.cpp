// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/RynMessageBuffer.h"

#include <array>
#include <charconv>
#include <cstdint>
#include <limits>
#include <utility>

namespace RynLog {

namespace {

template <typename Number>
void appendDigits(std::string& text, Number number, int base)
{
    std::array<char, std::numeric_limits<unsigned long long>::digits10 + 2> digits{};
    const auto end = std::to_chars(digits.begin(), digits.end(), number, base).ptr;
    text.append(digits.begin(), end);
}

} // namespace

std::string RynMessageBuffer::str()
{
    return std::exchange(text_, std::string());
}

void RynMessageBuffer::appendText(std::string_view text)
{
    text_ += text;
}

void RynMessageBuffer::appendText(const char* text)
{
    text_ += text != nullptr ? text : "(null)";
}

void RynMessageBuffer::appendAddress(const void* address)
{
    if (address != nullptr)
        text_ += "0x";
    appendDigits(text_, reinterpret_cast<std::uintptr_t>(address), 16);
}

void RynMessageBuffer::append(bool value)
{
    text_ += value ? '1' : '0';
}

void RynMessageBuffer::appendSigned(long long number)
{
    appendDigits(text_, number, 10);
}

void RynMessageBuffer::appendUnsigned(unsigned long long number)
{
    appendDigits(text_, number, 10);
}

RynMessageBuffer& operator<<(RynMessageBuffer& buffer, const _CMPIBroker* broker)
{
    return buffer << static_cast<const void*>(broker);
}

} // namespace RynLog
