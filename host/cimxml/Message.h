// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/cimxml/Element.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace Host::CimXml {

// The MESSAGE in a request's body (DSP0201), with a simple request of one call. Immutable; may be
// read from any thread. The caller bounds the size of the body.
class Message {
public:
    // Throws RequestError for a body that is no such message.
    explicit Message(std::string_view body, std::size_t maximumDepth = defaultMaximumDepth);

    // The attributes ID and PROTOCOLVERSION, which the response repeats.
    const std::string& id() const noexcept { return id_; }
    const std::string& protocolVersion() const noexcept { return protocolVersion_; }
    // The name of the intrinsic or extrinsic method, as the client spells it.
    const std::string& methodName() const noexcept { return methodName_; }
    // Returns whether the method is one of the protocol itself (DSP0200) and not of a class.
    bool isIntrinsic() const noexcept { return isIntrinsic_; }
    // The namespace as the client spells it, such as root/cimv2.
    const std::string& nameSpace() const noexcept { return nameSpace_; }

    // The size of the body in bytes.
    std::size_t size() const noexcept { return size_; }

    // The IMETHODCALL or METHODCALL.
    const Element& call() const noexcept { return *call_; }
    // The LOCALNAMESPACEPATH of an IMETHODCALL; the LOCALCLASSPATH or LOCALINSTANCEPATH of a
    // METHODCALL.
    const Element& path() const noexcept { return *path_; }

private:
    Element root_;
    // Within the root, on the heap: they stay where they are when the message is moved.
    const Element* call_;
    const Element* path_;
    std::size_t size_;
    std::string id_;
    std::string protocolVersion_;
    std::string methodName_;
    bool isIntrinsic_;
    std::string nameSpace_;
};

} // namespace Host::CimXml
