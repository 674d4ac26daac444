// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/RequestHead.h"

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>

namespace Host::Http {

// What a client receives piece by piece, as it comes into being.
class Stream {
public:
    virtual ~Stream() = default;

    // Blocks until there is a piece. Returns null at the end of the stream.
    virtual std::shared_ptr<const std::string> next() = 0;
    // Ends the stream, also while next() blocks in another thread. Blocks only briefly.
    virtual void end() noexcept = 0;
};

struct Representation {
    std::vector<HeaderField> fields; // with the Content-Type
    std::shared_ptr<const std::string> content;
    unsigned status = 200;
    std::unique_ptr<Stream> stream = nullptr; // instead of the content, if there is one
};

// What clients read by GET and HEAD (RFC 9110, 9.3). Thread-safe.
class Resource {
public:
    virtual ~Resource() = default;

    // Returns a representation of the present state. Blocks the connection's thread; the content is
    // kept until the client has fetched it, and the stream until one side ends it. Throws HttpError
    // to answer otherwise.
    virtual Representation represent(const RequestHead& head) = 0;
};

using Resources = std::map<std::string, std::reference_wrapper<Resource>>; // by path

} // namespace Host::Http
