// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Responses to operations.

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "host/cimxml/ResponseWriter.h"
#include "host/operations/FoundObjects.h"

#include <cstddef>
#include <optional>
#include <string>

namespace Host {

// The enumeration context that operations which open an enumeration or pull return; nothing at the
// end of the sequence.
struct Continuation {
    std::optional<std::string> context;
};

// A response whose objects become XML when its pieces are asked for. Broker and repository must
// outlive it.
class ObjectResponse : public CimXml::Response {
public:
    ObjectResponse(const CimXml::Message& message, CimXml::OperationKind kind,
        const Repository& classes, CimXml::Location location, CimXml::ObjectSelection selection,
        FoundObjects objects, std::optional<Continuation> continuation);

    bool append(std::string& out) override;
    // Counts those of earlier pulls too, which are in the same memory.
    std::size_t heldObjects() const noexcept override { return objects_.heldObjects(); }

private:
    void finish(std::string& out);

    FoundObjects objects_;
    std::size_t next_ = 0;
    std::optional<Continuation> continuation_;
    CimXml::ResponseWriter writer_;
    bool isFinished_ = false;
};

// A response that is written already, such as one of an error.
class WrittenResponse : public CimXml::Response {
public:
    explicit WrittenResponse(std::string text, unsigned status = 0)
        : text_(std::move(text)), status_(status)
    {
    }

    bool append(std::string& out) override;
    std::size_t heldObjects() const noexcept override { return 0; }
    unsigned status() const noexcept override { return status_; }

private:
    std::string text_; // empty once it was appended
    unsigned status_;
};

} // namespace Host
