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

#include <algorithm>
#include <chrono>
#include <cstring>
#include <exception>
#include <new>
#include <string>
#include <utility>

namespace Host::Http {

namespace {

// So much of an answer is written before it is sent. One that is no longer has a known length.
constexpr std::size_t answerHead = std::size_t{64} << 10;

HttpError unauthorized()
{
    return {Status::unauthorized, "sign in with a name and a password", {},
        {{"WWW-Authenticate", R"(Basic realm="sensor-profile", charset="UTF-8")"}}};
}

HttpError overloaded()
{
    return {Status::unavailable, "too many requests are waiting", {}, {{"Retry-After", "1"}}};
}

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
    if (service_.signIns.isKnown(*credentials, now))
        return;
    if (!service_.connections.mayFallAsleep())
        throw overloaded();
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
            service_.timer.at(time, hand);
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
        const auto admission = signIns.admission(client_.neighbourhood, now);
        if (admission > now && !service_.connections.isWindingUp())
            return tryPasswordAt(admission, credentials);
        if (admission > now) {
            error_ = overloaded();
            return wakeUp();
        }
        if (!signIns.areDemanded() || signIns.tryPassword(credentials, client_.address))
            return wakeUp();
        error_ = unauthorized();
        const auto end =
            signIns.delayFailure(client_.neighbourhood, std::chrono::steady_clock::now());
        service_.timer.at(end, [this] { wakeUp(); });
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
        error_ = overloaded();
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
            answer_.reset();
    } catch (...) {
        report({"work", "Exchange", __LINE__}, "no memory for a request");
        isLost_ = true;
    }
    wakeUp();
}

void Exchange::carryOut()
{
    const CimXml::Message message(body_, service_.limits.maximumDepth);
    body_ = {};
    requireMatch(head_, message);
    answer_ = service_.operations.answer(message, caller_);
    while (piece_.size() < answerHead) {
        if (answer_->append(piece_))
            continue;
        answer_.reset();
        break;
    }
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
        error_ = overloaded();
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

::ssize_t Exchange::read(char* to, std::size_t room) noexcept
{
    try {
        // The rest of a piece goes with the next one: each time the library is handed a little, it
        // makes a packet of it.
        if (answer_ && piece_.size() - sent_ < room) {
            piece_.erase(0, sent_);
            sent_ = 0;
        }
        while (answer_ && piece_.size() < room)
            if (!answer_->append(piece_))
                answer_.reset();
    } catch (...) {
        report({"read", "Exchange", __LINE__}, "an answer broke off");
        return MHD_CONTENT_READER_END_WITH_ERROR;
    }
    if (sent_ == piece_.size())
        return MHD_CONTENT_READER_END_OF_STREAM;
    const std::size_t count = std::min(room, piece_.size() - sent_);
    std::memcpy(to, piece_.data() + sent_, count);
    sent_ += count;
    return static_cast<::ssize_t>(count);
}

bool Exchange::sendAnswer()
{
    Response response =
        answer_ ? Response::inPieces(*this) : Response::whole(piece_); // which outlives it
    for (const HeaderField& field : answerFieldsFor(head_))
        response.add(field);
    if (service_.connections.isWindingUp())
        response.endConnection();
    state_ = State::answered;
    service_.connections.enter(client_, Phase::answering);
    return response.queue(connection_, Status::ok);
}

bool Exchange::sendError()
{
    piece_ = std::string(error_->what()) + "\n";
    Response response = Response::whole(piece_);
    response.add({"Content-Type", "text/plain; charset=utf-8"});
    if (!error_->cimError().empty())
        response.add({"CIMError", error_->cimError()});
    for (const HeaderField& field : error_->fields())
        response.add(field);
    if (error_->endsConnection() || service_.connections.isWindingUp())
        response.endConnection();
    mention({"sendError", "Exchange", __LINE__},
        std::to_string(error_->status()) + " to " + client_.address + ": " + error_->what());
    state_ = State::answered;
    service_.connections.enter(client_, Phase::answering);
    return response.queue(connection_, error_->status());
}

} // namespace Host::Http
