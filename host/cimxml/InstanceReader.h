// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Property values and instances in a request.

#pragma once

#include "host/broker/Instance.h"
#include "host/cimxml/PathReader.h"

#include <optional>
#include <string>

namespace Host::CimXml {

// What it makes lives in the arena of this thread's request. Throws what PathReader throws, and
// Refusal (CMPI_RC_ERR_INVALID_PARAMETER) with the property's name where a value does not fit.
class InstanceReader {
public:
    explicit InstanceReader(const Repository& classes) : classes_(classes), paths_(classes) {}

    // An INSTANCE, at the path, or at one without keys when that is null. Properties are typed
    // and named as the class declares them; where it is not known, by their TYPE.
    const Instance& instance(
        const Element& element, std::string_view nameSpace, const ObjectPath* path = nullptr) const;

    // A VALUE, VALUE.ARRAY or VALUE.REFERENCE, or null for none. The name is for errors.
    Value value(const std::optional<Element>& element, CMPIType type, const std::string& what,
        std::string_view nameSpace) const;

private:
    void setProperty(Instance& instance, const Element& element, const ClassDeclaration* declared,
        std::string_view nameSpace) const;

    const Repository& classes_;
    PathReader paths_;
};

} // namespace Host::CimXml
