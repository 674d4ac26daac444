// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The interface between a transport and the component that executes operations.

#pragma once

#include <cstddef>
#include <memory>
#include <string>

namespace Host::CimXml {

class Message;

// The client that sent a message, as the transport identified it.
struct Caller {
    std::string principal; // the authenticated user; empty without authentication
    std::string address;   // for the log
};

// The response to one message. Used by one thread at a time, which need not be the one that created
// it.
class Response {
public:
    virtual ~Response() = default;

    // Appends the next piece, a few kilobytes of a response with many objects, and returns true;
    // returns false at the end of the response.
    virtual bool append(std::string& out) = 0;

    // Returns the number of objects that stay in memory as long as the response does.
    virtual std::size_t heldObjects() const noexcept = 0;

    // Returns the status code of the operation (DSP0200); 0 when it succeeded.
    virtual unsigned status() const noexcept { return 0; }
};

// Thread-safe.
class OperationHandler {
public:
    virtual ~OperationHandler() = default;

    // Executes the operation; a failed operation yields an error response. The response holds the
    // objects and writes their XML when its pieces are requested. Throws RequestError for a message
    // that is not loosely valid, and std::bad_alloc.
    virtual std::unique_ptr<Response> answer(const Message& message, const Caller& caller) = 0;
};

} // namespace Host::CimXml
