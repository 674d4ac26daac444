// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/HttpError.h"

#include <memory>
#include <string>

struct MHD_Connection;
struct MHD_Response;

namespace Host::Http {

class PendingAnswer;
class StreamedAnswer;

// The header fields and the body of an answer, as libmicrohttpd sends them. All functions throw
// std::bad_alloc.
class MhdResponse {
public:
    // Creates one whose body is the text, which must not change until the request ends.
    static MhdResponse whole(const std::string& text);
    // Creates one whose body is read from the answer, which must exist until the request ends.
    static MhdResponse inPieces(PendingAnswer& answer);
    static MhdResponse inPieces(StreamedAnswer& answer);

    void add(const HeaderField& field);
    // Has the connection closed after the answer, which says so.
    void endConnection();

    // Returns false when the library refuses it.
    bool queue(MHD_Connection& connection, unsigned status);

private:
    struct Freeing {
        void operator()(MHD_Response* response) const;
    };

    explicit MhdResponse(MHD_Response* response);

    std::unique_ptr<MHD_Response, Freeing> response_;
};

} // namespace Host::Http
