// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/Literal.h"

#include "host/broker/Names.h"
#include "host/broker/Types.h"
#include "host/repository/TypeNames.h"

#include <tao/pegtl/parse_error.hpp>

#include <charconv>
#include <system_error>

namespace Host {

namespace {

[[noreturn]] void failAt(const Literal& literal, CMPIType type)
{
    throw tao::pegtl::parse_error(
        "the value is none of type " + nameOfType(type), literal.position);
}

template <typename Number>
Scalar toNumber(const Literal& literal, CMPIType type)
{
    Number value = 0;
    const char* const end = literal.text.data() + literal.text.size();
    const auto result = std::from_chars(literal.text.data(), end, value);
    // The bits beyond those of the type are all 0, or all 1 in a negative number.
    const Number rest = (value >> (plainSize(type) * 8 - 1)) >> (isUnsignedType(type) ? 1 : 0);
    const bool fits = rest == 0 || (isSignedType(type) && rest == static_cast<Number>(-1));
    if (result.ec != std::errc() || result.ptr != end || !fits)
        failAt(literal, type);
    return value;
}

Scalar toScalar(const Literal& literal, CMPIType type)
{
    using Kind = Literal::Kind;
    if (literal.kind == Kind::null)
        return {};
    if (literal.kind == Kind::truth && type == CMPI_boolean)
        return equalNames(literal.text, "true");
    if (literal.kind == Kind::text && type == CMPI_string)
        return literal.text;
    if (literal.kind == Kind::number && isUnsignedType(type))
        return toNumber<std::uint64_t>(literal, type);
    if (literal.kind == Kind::number && isSignedType(type))
        return toNumber<std::int64_t>(literal, type);
    failAt(literal, type);
}

} // namespace

Constant toConstant(const Initializer& written, CMPIType type)
{
    if (written.isEmpty())
        return {};
    const Literal& first = written.elements.front();
    if (!written.isList && first.kind == Literal::Kind::null)
        return {};
    if (written.isList != isArrayType(type))
        failAt(first, type);
    if (!written.isList)
        return toScalar(first, type);
    std::vector<Scalar> values;
    for (const Literal& element : written.elements)
        values.push_back(toScalar(element, elementType(type)));
    return values;
}

} // namespace Host
