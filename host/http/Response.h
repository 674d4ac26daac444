// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/HttpError.h"

#include <memory>
#include <string>

struct MHD_Connection;
struct MHD_Response;

namespace Host::Http {

class PendingAnswer;

// An answer with its head, ready to be sent. All but the destructor throw std::bad_alloc.
class Response {
public:
    // The text must stay as it is until the request ends.
    static Response whole(const std::string& text);
    // Which is read until then.
    static Response inPieces(PendingAnswer& answer);

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
