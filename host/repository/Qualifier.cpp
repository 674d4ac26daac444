// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/Qualifier.h"

#include "host/broker/Names.h"

namespace Host {

namespace {

template <typename T>
const T* valueOf(const QualifierList& qualifiers, std::string_view name)
{
    const Qualifier* const found = findQualifier(qualifiers, name);
    const Scalar* const value = found == nullptr ? nullptr : std::get_if<Scalar>(&found->value);
    return value == nullptr ? nullptr : std::get_if<T>(value);
}

} // namespace

const Qualifier* findQualifier(const QualifierList& qualifiers, std::string_view name)
{
    for (const Qualifier& qualifier : qualifiers)
        if (equalNames(qualifier.name(), name))
            return &qualifier;
    return nullptr;
}

bool isQualified(const QualifierList& qualifiers, std::string_view name)
{
    const auto* const value = valueOf<bool>(qualifiers, name);
    return value != nullptr && *value;
}

std::string_view qualifierText(const QualifierList& qualifiers, std::string_view name)
{
    const auto* const value = valueOf<std::string>(qualifiers, name);
    return value == nullptr ? std::string_view() : std::string_view(*value);
}

} // namespace Host
