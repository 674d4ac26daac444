// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/broker/Instance.h"
#include "host/cimxml/ObjectSelection.h"
#include "host/repository/Repository.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Host::CimXml {

// Appends VALUE, VALUE.ARRAY or VALUE.REFERENCE (DSP0201); nothing for a null. A null in an array
// is left out, since not all clients support VALUE.NULL. An embedded instance is the text of its
// INSTANCE.
void writeValue(std::string& out, const Value& value);

// Writes instances as INSTANCE with PROPERTY, PROPERTY.ARRAY or PROPERTY.REFERENCE for each
// selected property that the instance has, in its order. Data that a value lacks, such as the type
// of a null, is taken from the class. The markup around the values, which is the same in all
// instances of a class, is cached, which takes a third of the time of writing it anew. So is the
// text of arrays, many of which are the same in consecutive instances. Used by one thread at a
// time.
class InstanceMarkup {
public:
    explicit InstanceMarkup(ObjectSelection selection = {}) : selection_(std::move(selection)) {}

    // The class is null where it is not known; else it must outlive the object. All instances must
    // live until the last one is written.
    void write(std::string& out, const Instance& instance, const ClassDeclaration* declared);

private:
    // The element of a property, without its value, in markup_.
    struct Frame {
        std::string property;
        CMPIType valueType = CMPI_null;
        bool isSingle = false; // the value is the content of one VALUE
        std::size_t begin = 0;
        std::size_t valueAt = 0;
        std::size_t end = 0;          // equals the begin when the property is not selected
        std::size_t listedAt = 0;     // in listed_; its size where the property is not in it
        const Array* array = nullptr; // the value that was written last
        std::string arrayText;
    };

    void useClass(const ClassDeclaration* declared);
    Frame& frameFor(std::string_view property, const Value& value);
    static void writeArray(std::string& out, const Array& array, Frame& frame);

    ObjectSelection selection_;
    const ClassDeclaration* declared_ = nullptr;
    std::vector<Frame> frames_; // of that class
    std::string markup_;        // of the frames, in their order
    std::size_t next_ = 0;      // where the search begins

    // The properties of the class that are nulls where an instance lacks them.
    std::vector<std::string_view> listed_;
    std::vector<bool> isWritten_; // of these, in the present instance
};

} // namespace Host::CimXml
