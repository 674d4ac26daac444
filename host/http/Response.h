// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/HttpError.h"

#include <memory>
#include <string>

struct MHD_Connection;
struct MHD_Response;

namespace Host::Http {

class Exchange;

// An answer with its head, ready to be sent. All but the destructor throw std::bad_alloc.
class Response {
public:
    // The text must stay as it is until the exchange ends.
    static Response whole(const std::string& text);
    // The exchange is asked for the pieces.
    static Response inPieces(Exchange& exchange);

    void add(const HeaderField& field);
    // The connection is closed behind it, and the answer says so.
    void endConnection();

    // False when the library does not take it.
    bool queue(MHD_Connection& connection, unsigned status);

private:
    struct Freeing {
        void operator()(MHD_Response* response) const;
    };

    explicit Response(MHD_Response* response);

    std::unique_ptr<MHD_Response, Freeing> response_;
};

} // namespace Host::Http
