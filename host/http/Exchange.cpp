// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Exchange.h"

#include "host/cimxml/Message.h"
#include "host/cimxml/RequestError.h"
#include "host/http/ClientConnection.h"
#include "host/http/Connections.h"
#include "host/http/EventLog.h"
#include "host/http/Response.h"
#include "host/http/SignIns.h"
#include "host/http/Timer.h"
#include "host/http/WorkerPool.h"

#include <microhttpd.h>

#include <chrono>
#include <exception>
#include <new>
#include <string>
#include <utility>

namespace Host::Http {

namespace {

HttpError unauthorized()
{
    return {Status::unauthorized, "sign in with a name and a password", {},
        {{"WWW-Authenticate", R"(Basic realm="sensor-profile", charset="UTF-8")"}}};
}

HttpError unavailable(const std::string& reason)
{
    return {Status::unavailable, reason, {}, {{"Retry-After", "1"}}};
}

constexpr const char* ending = "the server is ending";

} // namespace

bool Exchange::begin(const RequestHead& head, std::size_t headSize)
{
    state_ = State::receiving;
    try {
        bodySize_ = bodySizeOf(head);
        if (headSize > service_.limits.maximumHeader)
            throw HttpError(Status::headerTooLarge,
                "a head holds at most " + std::to_string(service_.limits.maximumHeader) + " bytes");
        head_ = checkHead(head, bodySize_, service_.limits);
        caller_.address = client_.address;
        caller_.acceptLanguage = head_.acceptLanguage;
        if (service_.signIns.areDemanded())
            signIn(head);
    } catch (const HttpError& error) {
        return refuse(error);
    }
    return true;
}

void Exchange::signIn(const RequestHead& head)
{
    const auto field = head.find("Authorization");
    const auto credentials = field ? basicCredentials(*field) : std::nullopt;
    if (!credentials)
        throw unauthorized();
    caller_.principal = credentials->user;
    const auto now = std::chrono::steady_clock::now();
    if (service_.signIns.isKnown(*credentials, client_.address, now))
        return;
    if (!service_.connections.mayFallAsleep())
        throw unavailable(ending);
    service_.connections.enter(client_, Phase::working);
    fallAsleep(State::signingIn);
    tryPasswordAt(service_.signIns.admission(client_.neighbourhood, now), *credentials);
}

void Exchange::tryPasswordAt(
    std::chrono::steady_clock::time_point time, const Credentials& credentials)
{
    try {
        const auto hand = [this, credentials] {
            handOver([this, credentials] { tryPassword(credentials); });
        };
        if (time <= std::chrono::steady_clock::now())
            hand();
        else
            service_.timer.atOrSooner(time, hand);
    } catch (...) {
        isLost_ = true;
        wakeUp();
    }
}

void Exchange::tryPassword(const Credentials& credentials)
{
    SignIns& signIns = service_.signIns;
    try {
        // Somebody else at the address may have failed meanwhile.
        const auto now = std::chrono::steady_clock::now();
        const auto admission = signIns.admit(client_.neighbourhood, now);
        if (admission > now && !service_.connections.isWindingUp())
            return tryPasswordAt(admission, credentials);
        if (admission > now) {
            error_ = unavailable(ending);
            return wakeUp();
        }
        const auto refusal =
            signIns.tryPassword(credentials, client_.address, client_.neighbourhood, now);
        if (!refusal)
            return wakeUp();
        error_ = unauthorized();
        service_.timer.atOrSooner(*refusal, [this] { wakeUp(); });
    } catch (...) {
        isLost_ = true;
        wakeUp();
    }
}

// REQUIRES: none of the body was received.
bool Exchange::refuse(const HttpError& error)
{
    error_ = error;
    // A client that still sends would not see an answer before it has finished, or not at all;
    // and the library ends connections that are answered before the request's end.
    const bool isBodyBearable = bodySize_.bytes.value_or(0) <= 2 * service_.limits.maximumBody;
    if (isBodyBearable && !bodySize_.isAwaited && !error.endsConnection()) {
        state_ = State::discarding;
        return true;
    }
    return sendError();
}

bool Exchange::proceed(std::string_view piece)
{
    if (isLost_)
        return false;
    if (isHeadToBeRepeated_) {
        isHeadToBeRepeated_ = false;
        state_ = State::receiving;
        service_.connections.enter(client_, Phase::receiving);
        return error_ ? refuse(HttpError(*error_)) : true;
    }
    switch (state_) {
    case State::receiving:
        return receive(piece);
    case State::discarding:
        if (piece.empty())
            return sendError();
        discarded_ += piece.size();
        return discarded_ <= 2 * service_.limits.maximumBody;
    case State::working:
        return error_ ? sendError() : sendAnswer();
    default:
        return false;
    }
}

bool Exchange::receive(std::string_view piece)
{
    if (piece.empty())
        return startWork();
    if (body_.size() + piece.size() <= service_.limits.maximumBody) {
        body_.append(piece);
        return true;
    }
    discarded_ = body_.size() + piece.size();
    error_.emplace(Status::contentTooLarge,
        "a body holds at most " + std::to_string(service_.limits.maximumBody) + " bytes");
    body_ = {};
    state_ = State::discarding;
    return true;
}

bool Exchange::startWork()
{
    if (!service_.connections.mayFallAsleep()) {
        error_ = unavailable(ending);
        return sendError();
    }
    service_.connections.enter(client_, Phase::working);
    fallAsleep(State::working);
    handOver([this] { work(); });
    return true;
}

void Exchange::work() noexcept
{
    try {
        try {
            carryOut();
        } catch (const HttpError& error) {
            error_ = error;
        } catch (const CimXml::RequestError& error) {
            error_ = HttpError(error);
        } catch (const std::bad_alloc&) {
            throw;
        } catch (const std::exception& error) {
            report(
                {"work", "Exchange", __LINE__}, std::string("a request failed: ") + error.what());
            error_ = HttpError(Status::internalError, "the request failed; the log tells why");
        }
        if (error_)
            answer_.drop();
    } catch (...) {
        report({"work", "Exchange", __LINE__}, "no memory for a request");
        isLost_ = true;
    }
    wakeUp();
}

void Exchange::carryOut()
{
    // The message goes before the answer, which may give back the memory of both.
    const auto answer = [this] {
        const CimXml::Message message(body_, service_.limits.maximumDepth);
        body_ = {};
        requireMatch(head_, message);
        return service_.operations.answer(message, caller_);
    };
    answer_.begin(answer(), service_.unsent);
}

void Exchange::fallAsleep(State state)
{
    state_ = state;
    isHeadToBeRepeated_ = state == State::signingIn;
    ::MHD_suspend_connection(&connection_);
}

void Exchange::handOver(std::function<void()> job) noexcept
{
    try {
        if (service_.workers.take(std::move(job)))
            return;
        error_ = unavailable("too many requests are waiting");
    } catch (...) {
        isLost_ = true;
    }
    wakeUp();
}

// The last thing a worker does with the exchange: its connection's thread takes over.
void Exchange::wakeUp() noexcept
{
    Connections& connections = service_.connections;
    ::MHD_resume_connection(&connection_);
    connections.awake();
}

bool Exchange::sendAnswer()
{
    // The exchange outlives it.
    Response response =
        answer_.isWhole() ? Response::whole(answer_.text()) : Response::inPieces(answer_);
    for (const HeaderField& field : answerFieldsFor(head_))
        response.add(field);
    if (service_.connections.isWindingUp())
        response.endConnection();
    return send(response, Status::ok);
}

bool Exchange::sendError()
{
    errorText_ = std::string(error_->what()) + "\n";
    Response response = Response::whole(errorText_);
    response.add({"Content-Type", "text/plain; charset=utf-8"});
    if (!error_->cimError().empty())
        response.add({"CIMError", error_->cimError()});
    for (const HeaderField& field : error_->fields())
        response.add(field);
    if (error_->endsConnection() || service_.connections.isWindingUp())
        response.endConnection();
    return send(response, error_->status());
}

bool Exchange::send(Response& response, unsigned status)
{
    if (isMentionWanted())
        mention({"send", "Exchange", __LINE__}, summary(status));
    state_ = State::answered;
    service_.connections.enter(client_, Phase::answering);
    return response.queue(connection_, status);
}

// Whom the answer goes to, and what it is about. The name is one that the client was let in with,
// but for errors that say otherwise.
std::string Exchange::summary(unsigned status) const
{
    std::string text = std::to_string(status) + " to " + client_.address;
    if (!caller_.principal.empty())
        text += ", \"" + caller_.principal + "\"";
    if (head_.method)
        text += ", " + *head_.method;
    if (head_.object)
        text += " in " + *head_.object;
    if (error_)
        text += std::string(": ") + error_->what();
    return text;
}

} // namespace Host::Http
