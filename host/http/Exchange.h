// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A request, what becomes of it, and its answer.

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "host/http/BasicCredentials.h"
#include "host/http/HeaderCheck.h"
#include "host/http/HttpError.h"
#include "host/http/PendingAnswer.h"

#include <chrono>
#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

struct MHD_Connection;

namespace Host::Http {

class Connections;
class Response;
class SignIns;
class Timer;
class WorkerPool;
struct ClientConnection;

// What all exchanges share. Outlives them.
struct Service {
    CimXml::OperationHandler& operations;
    const Limits& limits;
    SignIns& signIns;
    Connections& connections;
    Timer& timer;
    WorkerPool& workers;
    UnsentObjects& unsent;
};

// Driven by the thread that serves the connection. While a password is checked or an operation
// runs, the connection sleeps, and the exchange is the worker's.
class Exchange {
public:
    Exchange(Service& service, ClientConnection& client, MHD_Connection& connection)
        : service_(service), client_(client), connection_(connection)
    {
    }
    Exchange(const Exchange&) = delete;
    Exchange& operator=(const Exchange&) = delete;

    // To be called with the head when it has come, then with each piece of the body, with an
    // empty piece at its end, and whenever the connection has woken up. False when the connection
    // must be closed without an answer.
    bool begin(const RequestHead& head, std::size_t headSize);
    bool proceed(std::string_view piece);

private:
    enum class State {
        fresh,
        signingIn, // asleep
        receiving,
        discarding, // the error is known, the client still sends
        working,    // asleep
        answered,
    };

    void signIn(const RequestHead& head);
    void tryPasswordAt(std::chrono::steady_clock::time_point time, const Credentials& credentials);
    void tryPassword(const Credentials& credentials);
    bool refuse(const HttpError& error);
    bool receive(std::string_view piece);
    bool startWork();
    void work() noexcept;
    void carryOut();
    void fallAsleep(State state);
    void handOver(std::function<void()> job) noexcept;
    void wakeUp() noexcept;

    bool sendAnswer();
    bool sendError();
    bool send(Response& response, unsigned status);
    std::string summary(unsigned status) const;

    Service& service_;
    ClientConnection& client_;
    MHD_Connection& connection_;
    State state_ = State::fresh;

    BodySize bodySize_;
    CallHead head_;
    CimXml::Caller caller_;
    std::string body_;
    std::size_t discarded_ = 0;
    bool isHeadToBeRepeated_ = false;

    std::optional<HttpError> error_;
    bool isLost_ = false; // not even an error can be told

    PendingAnswer answer_;
    std::string errorText_;
};

} // namespace Host::Http
