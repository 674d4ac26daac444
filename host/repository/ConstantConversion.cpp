// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/ConstantConversion.h"

#include "host/broker/Arena.h"
#include "host/broker/DateTime.h"
#include "host/broker/Refusal.h"
#include "host/broker/Types.h"
#include "host/repository/MofError.h"
#include "host/repository/Words.h"

#include <cmath>
#include <limits>

namespace Host {

namespace {

// Of one literal, whose type is no array.
class Conversion {
public:
    Conversion(const Syntax::Literal& literal, CMPIType type) : literal_(literal), type_(type) {}

    Scalar operator()(std::monostate) const { return std::monostate(); }

    Scalar operator()(bool value) const
    {
        if (type_ != CMPI_boolean)
            mismatch("a boolean");
        return value;
    }

    Scalar operator()(const Syntax::Integer& value) const
    {
        if (isUnsignedType(type_))
            return unsignedValue(value);
        if (isSignedType(type_))
            return signedValue(value);
        if (type_ != CMPI_real32 && type_ != CMPI_real64)
            mismatch("an integer");
        const auto magnitude = static_cast<double>(value.magnitude);
        return value.isNegative ? -magnitude : magnitude;
    }

    Scalar operator()(double value) const
    {
        if (type_ != CMPI_real32 && type_ != CMPI_real64)
            mismatch("a real");
        if (type_ == CMPI_real32 && std::abs(value) > std::numeric_limits<float>::max())
            outOfRange();
        return value;
    }

    Scalar operator()(const Syntax::Character& value) const
    {
        if (type_ != CMPI_char16)
            mismatch("a character");
        return std::uint64_t{value.unit};
    }

    Scalar operator()(const std::string& value) const
    {
        if (type_ == CMPI_dateTime)
            requireDateTime(value);
        else if (type_ != CMPI_string && type_ != CMPI_ref)
            mismatch("a string");
        return value;
    }

private:
    [[noreturn]] void fail(const std::string& reason) const
    {
        throw MofError(literal_.position, reason);
    }

    [[noreturn]] void mismatch(const char* what) const
    {
        fail(std::string(what) + " is no value of type " + nameOfType(type_));
    }

    [[noreturn]] void outOfRange() const
    {
        fail("the number does not fit into type " + nameOfType(type_));
    }

    unsigned bits() const { return static_cast<unsigned>(plainSize(type_)) * 8; }

    Scalar unsignedValue(const Syntax::Integer& value) const
    {
        const std::uint64_t most = std::numeric_limits<std::uint64_t>::max() >> (64U - bits());
        if (value.magnitude > most || (value.isNegative && value.magnitude != 0))
            outOfRange();
        return value.magnitude;
    }

    Scalar signedValue(const Syntax::Integer& value) const
    {
        const std::uint64_t below = std::uint64_t{1} << (bits() - 1);
        if (value.magnitude > (value.isNegative ? below : below - 1))
            outOfRange();
        return static_cast<std::int64_t>(value.isNegative ? 0 - value.magnitude : value.magnitude);
    }

    void requireDateTime(const std::string& text) const
    {
        Arena arena;
        try {
            DateTime::parse(arena, text);
        } catch (const Refusal&) {
            fail(quotation(text) + " is no value of type datetime");
        }
    }

    const Syntax::Literal& literal_;
    CMPIType type_;
};

Scalar toScalar(const Syntax::Literal& literal, CMPIType type)
{
    return std::visit(Conversion(literal, type), literal.value);
}

} // namespace

Constant toConstant(const Syntax::Initializer& written, CMPIType type)
{
    const bool isNullLiteral =
        !written.isArray && std::holds_alternative<std::monostate>(written.elements.front().value);
    if (isNullLiteral)
        return Scalar();
    if (written.isArray != isArrayType(type))
        throw MofError(written.position,
            (written.isArray ? "a list is no value of type " : "a single value is none of type ") +
                nameOfType(type));
    if (!written.isArray)
        return toScalar(written.elements.front(), type);
    std::vector<Scalar> values;
    for (const Syntax::Literal& element : written.elements)
        values.push_back(toScalar(element, elementType(type)));
    return values;
}

} // namespace Host
