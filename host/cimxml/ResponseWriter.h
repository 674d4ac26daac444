// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Responses as XML: the elements of DSP0201 that an operation of DSP0200 returns.

#pragma once

#include "host/cimxml/InstanceElement.h"
#include "host/cimxml/ObjectSelection.h"
#include "host/cimxml/Operation.h"
#include "host/cimxml/PathElement.h"
#include "host/repository/Repository.h"

#include <cmpidt.h>

#include <optional>
#include <string>
#include <string_view>

namespace Host::CimXml {

class Message;

// Returns the whole response of an operation that failed.
std::string errorResponse(const Message& message, CMPIrc code, std::string_view description);

// Appends the response of a successful operation: the beginning, each object in the element in
// which the operation returns it, and the end. Instances must live until the last one is appended.
// Used by one thread at a time.
class ResponseWriter {
public:
    // The repository must outlive the writer. The selection is the operation's own; for one that
    // pulls, that of the operation that opened the enumeration.
    ResponseWriter(const Message& message, OperationKind kind, const Repository& classes,
        Location location, ObjectSelection selection);

    void begin(std::string& out) const;

    // REQUIRES: the thread has a current arena, in which the path of the instance is made.
    void instance(std::string& out, const Instance& instance);
    void path(std::string& out, const ObjectPath& path) const;
    void classDeclaration(std::string& out, const ClassDeclaration& declared) const;
    void className(std::string& out, std::string_view name) const;
    void qualifierDeclaration(std::string& out, const QualifierDeclaration& declared) const;
    // Appends the value of a property.
    void value(std::string& out, const Value& value) const;

    void finish(std::string& out) const;
    // Finishes the response of an operation that opens an enumeration or pulls. Without a context
    // the enumeration has ended.
    void finish(std::string& out, const std::optional<std::string>& enumerationContext) const;

private:
    std::string head_;
    OperationKind kind_;
    const Repository& classes_;
    Location location_;
    ObjectSelection selection_;
    InstanceMarkup instances_;
};

} // namespace Host::CimXml
