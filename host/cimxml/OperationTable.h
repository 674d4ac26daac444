// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The supported intrinsic operations with their parameters (DSP0200).

#pragma once

#include "host/cimxml/Operation.h"

#include <concepts>
#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>

namespace Host::CimXml {

enum class Parameter : std::uint8_t {
    assocClass,
    className,
    continueOnError,
    deepInheritance,
    enumerationContext,
    filterQuery,
    filterQueryLanguage,
    includeClassOrigin,
    includeQualifiers,
    instanceName,
    localOnly,
    maxObjectCount,
    objectName,
    operationTimeout,
    propertyList,
    propertyName,
    qualifierName,
    resultClass,
    resultRole,
    role,
};
inline constexpr std::size_t parameterCount = 20;

class ParameterSet {
public:
    template <std::same_as<Parameter>... Parameters>
    constexpr ParameterSet(Parameters... parameters) : bits_((0U | ... | bit(parameters)))
    {
    }
    constexpr bool has(Parameter parameter) const { return (bits_ & bit(parameter)) != 0; }
    constexpr ParameterSet operator|(ParameterSet other) const
    {
        ParameterSet sum;
        sum.bits_ = bits_ | other.bits_;
        return sum;
    }

private:
    static constexpr std::uint32_t bit(Parameter parameter)
    {
        return std::uint32_t{1} << static_cast<unsigned>(parameter);
    }
    std::uint32_t bits_;
};

struct OperationForm {
    OperationKind kind;
    std::string_view name;
    ParameterSet required;
    ParameterSet optional;
    ParameterSet trueByDefault;
};

// Returns the operations that are offered.
std::span<const OperationForm> offeredOperations();

// Finds an operation by its name, in any letter case. Returns null for one that is not offered.
const OperationForm* findOperation(std::string_view name);

// Returns the parameter's name as DSP0200 spells it.
std::string_view nameOf(Parameter parameter);

} // namespace Host::CimXml
