// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Values and instances as elements.

#pragma once

#include "host/broker/Instance.h"
#include "host/cimxml/PropertySelection.h"
#include "host/repository/Repository.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Host::CimXml {

// VALUE, VALUE.ARRAY or VALUE.REFERENCE; nothing for a null. A null in an array is left out and
// what follows moves up, since not all clients know an element for it. An embedded instance is
// the text of its INSTANCE.
void writeValue(std::string& out, const Value& value);

// INSTANCE with PROPERTY, PROPERTY.ARRAY or PROPERTY.REFERENCE for each selected property that the
// instance has, in its order. What the value does not say, such as the type of a null, and the
// class's own attributes come from the class where it is known. With the class origin comes
// PROPAGATED. Remembers what stands around the values, which is the same in all instances of
// a class. Used by one thread at a time.
class InstanceWriter {
public:
    explicit InstanceWriter(PropertySelection selection = {}) : selection_(std::move(selection)) {}

    // The class may be null where it is not known; else it must outlive the writer.
    void write(std::string& out, const Instance& instance, const ClassDeclaration* declared);

private:
    // A property's element without its value.
    struct Frame {
        std::string property;
        CMPIType valueType = CMPI_null;
        std::string text; // empty when the property is not selected
        std::size_t valueAt = 0;
    };

    const Frame& frameFor(std::string_view property, CMPIType valueType);
    Frame makeFrame(std::string_view property, CMPIType valueType) const;

    PropertySelection selection_;
    const ClassDeclaration* declared_ = nullptr;
    std::vector<Frame> frames_; // of that class
    std::size_t next_ = 0;      // where the search begins
};

} // namespace Host::CimXml
