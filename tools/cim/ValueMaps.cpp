// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/ValueMaps.h"

#include "host/repository/ClassDeclaration.h"

#include <algorithm>
#include <string>

namespace Tools {

namespace {

using Texts = std::vector<Host::Scalar>;

// Returns the value of a qualifier; null where it is absent or no array.
const Texts* textsOf(const Host::PropertyDeclaration& property, std::string_view name)
{
    const Host::Qualifier* const qualifier = Host::findQualifier(property.qualifiers, name);
    return qualifier == nullptr ? nullptr : std::get_if<Texts>(&qualifier->value);
}

} // namespace

std::string_view meaningOf(
    const Host::ClassDeclaration* declared, std::string_view property, std::uint64_t code)
{
    const auto* const found = declared == nullptr ? nullptr : declared->property(property);
    const Texts* const codes = found == nullptr ? nullptr : textsOf(*found, "ValueMap");
    const Texts* const meanings = found == nullptr ? nullptr : textsOf(*found, "Values");
    if (codes == nullptr || meanings == nullptr)
        return {};
    const Host::Scalar wanted = std::to_string(code);
    for (std::size_t i = 0; i < std::min(codes->size(), meanings->size()); ++i)
        if (codes->at(i) == wanted)
            return std::get<std::string>(meanings->at(i));
    return {};
}

} // namespace Tools
