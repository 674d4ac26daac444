// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A text stream for composing messages and parameter lists.

#pragma once

#include <concepts>
#include <locale>
#include <sstream>
#include <string>
#include <string_view>
#include <type_traits>

struct _CMPIBroker;

namespace RynLog {

// Prints as a std::ostream of the classic locale prints, whatever the process's locale is:
// pointers as addresses (0x... or 0), booleans as 0 or 1. A null text is printed as (null).
// The usual values are printed without a stream, since parameter lists are composed for every
// object of an enumeration. Not thread-safe.
class RynMessageBuffer {
public:
    template <typename Value>
    RynMessageBuffer& operator<<(const Value& value)
    {
        if constexpr (isText<Value>)
            appendText(value);
        else if constexpr (std::same_as<Value, bool> || isNumber<Value>)
            append(value);
        else if constexpr (isAddress<Value>)
            appendAddress(value);
        else
            appendStreamed(value);
        return *this;
    }

    // Returns the text streamed since the previous call.
    std::string str();

private:
    template <typename Value>
    static constexpr bool isText =
        std::convertible_to<const Value&, std::string_view> && !std::same_as<Value, std::nullptr_t>;

    // Character types print as characters, which is left to the stream.
    template <typename Value>
    static constexpr bool isNumber = std::integral<Value> && sizeof(Value) >= sizeof(short) &&
                                     !std::same_as<Value, wchar_t> &&
                                     !std::same_as<Value, char16_t> &&
                                     !std::same_as<Value, char32_t>;

    template <typename Value>
    static constexpr bool isAddress =
        std::is_pointer_v<Value>&& std::convertible_to<Value, const void*> &&
        !std::same_as<std::remove_cv_t<std::remove_pointer_t<Value>>, signed char> &&
        !std::same_as<std::remove_cv_t<std::remove_pointer_t<Value>>, unsigned char>;

    void appendText(std::string_view text);
    void appendText(const char* text);
    void appendText(const std::string& text) { appendText(std::string_view(text)); }
    void appendAddress(const void* address);
    void append(bool value);

    template <typename Number>
    void append(Number number)
    {
        if constexpr (std::is_signed_v<Number>)
            appendSigned(number);
        else
            appendUnsigned(number);
    }
    void appendSigned(long long number);
    void appendUnsigned(unsigned long long number);

    template <typename Value>
    void appendStreamed(const Value& value)
    {
        std::ostringstream stream;
        stream.imbue(std::locale::classic());
        stream << value;
        text_ += stream.view();
    }

    std::string text_;
};

// A broker is printed as its address.
RynMessageBuffer& operator<<(RynMessageBuffer& buffer, const _CMPIBroker* broker);

} // namespace RynLog
