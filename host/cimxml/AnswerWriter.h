// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The answer to a request, written piece by piece.

#pragma once

#include "host/broker/Value.h"
#include "host/cimxml/InstanceWriter.h"
#include "host/cimxml/Operation.h"
#include "host/cimxml/PathWriter.h"
#include "host/repository/Repository.h"

#include <cmpidt.h>

#include <functional>
#include <string>
#include <string_view>

namespace Host::CimXml {

class Message;

// The whole of an answer that tells of a failure.
std::string errorAnswer(const Message& message, CMPIrc code, std::string_view description);

// The message goes to the sink in pieces: the head with the first object, one piece for each
// object after it, and what finishes it. Until an object was written nothing has gone out, and
// errorAnswer() can still take its place. Which elements the objects become is the operation's to
// say. Objects need only be there for the call. Used by one thread at a time.
class AnswerWriter {
public:
    using Sink = std::function<void(std::string_view piece)>;

    // The repository must outlive the writer. The selection is the operation's own; for one that
    // pulls, that of the operation that opened the enumeration.
    AnswerWriter(const Message& message, OperationKind kind, const Repository& classes,
        Location location, PropertySelection selection, Sink sink);

    // REQUIRES: finish() was not called yet.
    void instance(const Instance& instance);
    void path(const ObjectPath& path);
    void classDeclaration(const ClassDeclaration& declared);
    // Of EnumerateClassNames, and of associations between classes.
    void className(std::string_view name);
    void qualifierDeclaration(const QualifierDeclaration& declared);
    // Of a property.
    void value(const Value& value);

    bool hasBegun() const noexcept { return hasBegun_; }

    // To be called once, after the last object.
    void finish();
    // The same for operations that open an enumeration or pull: what is left stays behind the
    // context; without one the sequence has ended.
    void finish(const std::optional<std::string>& enumerationContext);

private:
    void begin();
    void send();

    std::string id_;
    std::string protocolVersion_;
    std::string methodName_;
    OperationKind kind_;
    const Repository& classes_;
    Location location_;
    PropertySelection selection_;
    InstanceWriter instances_;
    Sink sink_;
    std::string piece_; // what goes out next
    bool hasBegun_ = false;
};

} // namespace Host::CimXml
