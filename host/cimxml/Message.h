// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A request's body as a message: whom it is for, and what its answer must repeat.

#pragma once

#include "host/cimxml/WellFormed.h"

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

namespace Host::CimXml {

class Document;

// One call of an operation. Immutable; may be read from any thread. The size of the body is the
// caller's to bound.
class Message {
public:
    // Throws RequestError for what is no such call, with the outcome to answer. Elements may stand
    // so deep in one another.
    explicit Message(std::string_view body, std::size_t maximumDepth = usualDepth);
    ~Message();
    Message(Message&&) noexcept;
    Message& operator=(Message&&) noexcept;

    // What the client calls the message.
    const std::string& id() const noexcept { return id_; }
    const std::string& protocolVersion() const noexcept { return protocolVersion_; }
    // The operation, or the method of a class, as the client spells it.
    const std::string& methodName() const noexcept { return methodName_; }
    // An operation of the protocol itself and no method of a class.
    bool isIntrinsic() const noexcept { return isIntrinsic_; }
    // Such as root/cimv2, as the client spells it.
    const std::string& nameSpace() const noexcept { return nameSpace_; }

    // Of the body, in bytes.
    std::size_t size() const noexcept { return size_; }

    // For the readers of this room.
    const Document& document() const noexcept { return *document_; }

private:
    std::unique_ptr<const Document> document_;
    std::size_t size_;
    std::string id_;
    std::string protocolVersion_;
    std::string methodName_;
    bool isIntrinsic_ = true;
    std::string nameSpace_;
};

} // namespace Host::CimXml
