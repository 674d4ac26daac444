// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "host/http/BasicCredentials.h"
#include "host/http/HeaderCheck.h"
#include "host/http/HttpError.h"
#include "host/http/PendingAnswer.h"
#include "host/http/Resource.h"
#include "host/http/StreamedAnswer.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

struct MHD_Connection;

namespace Host::Http {

class MhdResponse;
enum class Phase;
struct ClientConnection;
struct Service;

// One request and its answer. Runs on its connection's thread, which blocks while a password is
// checked and while the operation runs.
class Exchange {
public:
    Exchange(Service& service, ClientConnection& client, MHD_Connection& connection)
        : service_(service), client_(client), connection_(connection)
    {
    }
    Exchange(const Exchange&) = delete;
    Exchange& operator=(const Exchange&) = delete;

    // begin() takes the head; proceed() each piece of the body, and an empty piece at its end. Both
    // return false when the connection must be closed without an answer, and throw std::bad_alloc.
    bool begin(const RequestHead& head, std::size_t headSize);
    bool proceed(std::string_view piece);

private:
    enum class State {
        receiving,
        discarding, // there is an error, which is sent at the end of the body
        answered,
    };

    void findResource(const RequestHead& head);
    void checkRequest(const RequestHead& head);
    void signIn(const RequestHead& head);
    bool isPasswordRight(const Credentials& credentials);
    bool refuse();
    bool receive(std::string_view piece);
    bool execute();
    void runOperation();
    void readResource();
    void enter(Phase phase);

    bool sendAnswer();
    bool sendRepresentation();
    bool sendError();
    bool send(MhdResponse& response, unsigned status, Phase phase);
    std::string summary(unsigned status) const;

    Service& service_;
    ClientConnection& client_;
    MHD_Connection& connection_;
    State state_ = State::receiving;

    BodySize bodySize_;
    CallHead head_;
    Resource* resource_ = nullptr; // null for an operation
    RequestHead resourceHead_;
    CimXml::Caller caller_;
    std::string body_;
    std::size_t received_ = 0; // bytes of the body

    std::optional<HttpError> error_;

    PendingAnswer answer_;
    Representation representation_;
    std::optional<StreamedAnswer> stream_;
    std::string errorText_;
};

} // namespace Host::Http
