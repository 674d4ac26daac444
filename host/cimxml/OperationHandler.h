// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Where a transport takes the messages it has received.

#pragma once

#include <cstddef>
#include <memory>
#include <string>

namespace Host::CimXml {

class Message;

// Who asks, as the transport knows it.
struct Caller {
    std::string principal; // the name signed in with; empty where nobody signs in
    std::string address;   // for the log
    std::string acceptLanguage;
};

// The answer to one message, told in pieces. Used by one thread at a time, not always the one it
// was made on.
class Response {
public:
    virtual ~Response() = default;

    // Appends what comes next, some kilobytes at most for an answer of many objects; false when
    // the answer has ended and nothing was appended.
    virtual bool append(std::string& out) = 0;

    // How many objects are in memory for as long as the answer is not dropped.
    virtual std::size_t heldObjects() const noexcept = 0;
};

// Asked from any thread, by many at a time.
class OperationHandler {
public:
    virtual ~OperationHandler() = default;

    // Carries the operation out before it returns: whether it failed is settled by then, and a
    // failure is an answer too. What the answer holds, it holds once, as objects, and writes
    // them when its pieces are asked for. Throws RequestError for a message in which an element
    // lacks something, and std::bad_alloc.
    virtual std::unique_ptr<Response> answer(const Message& message, const Caller& caller) = 0;
};

} // namespace Host::CimXml
