// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/utilities/KeyValue.h"

#include "platform/utilities/ObjectAccess.h"

namespace Vorn {

namespace {

KeyValue integer(std::int64_t value)
{
    return KeyInteger{value < 0, static_cast<std::uint64_t>(value)};
}

KeyValue naturalNumber(std::uint64_t value)
{
    return KeyInteger{false, value};
}

KeyValue text(std::string_view characters)
{
    if (characters.data() == nullptr)
        return KeyAbsent{};
    return characters;
}

KeyValue path(const CMPIObjectPath* reference)
{
    if (reference == nullptr)
        return KeyAbsent{};
    return reference;
}

std::string_view viewOf(const char* characters)
{
    return characters != nullptr ? std::string_view(characters) : std::string_view();
}

// Returns the datetime format of DSP0004, section 5.2.4.
std::string_view standardForm(CMPIDateTime* dateTime)
{
    if (!isUsable(dateTime))
        return {};
    CMPIStatus status{};
    CMPIString* const form = dateTime->ft->getStringFormat(dateTime, &status);
    return status.rc == CMPI_RC_OK ? textOf(form) : std::string_view();
}

KeyValue presentValue(CMPIType type, const CMPIValue& value)
{
    switch (type) {
    case CMPI_boolean:
        return value.boolean != 0;
    case CMPI_char16:
        return static_cast<char16_t>(value.char16);
    case CMPI_uint8:
        return naturalNumber(value.uint8);
    case CMPI_uint16:
        return naturalNumber(value.uint16);
    case CMPI_uint32:
        return naturalNumber(value.uint32);
    case CMPI_uint64:
        return naturalNumber(value.uint64);
    case CMPI_sint8:
        return integer(value.sint8);
    case CMPI_sint16:
        return integer(value.sint16);
    case CMPI_sint32:
        return integer(value.sint32);
    case CMPI_sint64:
        return integer(value.sint64);
    case CMPI_real32:
        return static_cast<double>(value.real32);
    case CMPI_real64:
        return value.real64;
    case CMPI_string:
        return text(textOf(value.string));
    case CMPI_chars:
        return text(viewOf(value.chars));
    case CMPI_dateTime:
        return text(standardForm(value.dateTime));
    case CMPI_ref:
        return path(value.ref);
    default:
        return KeyUnusable{};
    }
}

} // namespace

std::string_view textOf(CMPIString* string)
{
    CMPIStatus status{};
    const char* const characters = charactersOf(string, &status);
    return status.rc == CMPI_RC_OK ? viewOf(characters) : std::string_view();
}

KeyValue keyValue(const CMPIData& data)
{
    constexpr unsigned absent = CMPI_nullValue | CMPI_notFound;
    if ((data.state & absent) != 0)
        return KeyAbsent{};
    if ((data.state & CMPI_badValue) != 0)
        return KeyUnusable{};
    return presentValue(data.type, data.value);
}

} // namespace Vorn
