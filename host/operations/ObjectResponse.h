// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Answers as a transport reads them.

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "host/cimxml/ResponseWriter.h"
#include "host/operations/FoundObjects.h"

#include <cstddef>
#include <optional>
#include <string>

namespace Host {

// What operations that open an enumeration or pull say of the rest. Without a context there is
// none: the sequence has ended.
struct Continuation {
    std::optional<std::string> context;
};

// Written object by object when pieces are asked for. Broker and repository must outlive it.
class ObjectResponse : public CimXml::Response {
public:
    ObjectResponse(const CimXml::Message& message, CimXml::OperationKind kind,
        const Repository& classes, CimXml::Location location, CimXml::ObjectSelection selection,
        FoundObjects objects, std::optional<Continuation> continuation);

    bool append(std::string& out) override;
    // With those that earlier answers to pulls told, which are in the same memory.
    std::size_t heldObjects() const noexcept override { return objects_.heldObjects(); }

private:
    void finish(std::string& out);

    FoundObjects objects_;
    std::size_t next_ = 0;
    std::optional<Continuation> continuation_;
    CimXml::ResponseWriter writer_;
    bool isFinished_ = false;
};

// One that is written already, such as that of a failure.
class WrittenResponse : public CimXml::Response {
public:
    explicit WrittenResponse(std::string text) : text_(std::move(text)) {}

    bool append(std::string& out) override;
    std::size_t heldObjects() const noexcept override { return 0; }

private:
    std::string text_; // empty once it was read
};

} // namespace Host
