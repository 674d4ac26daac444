// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Exchange.h"

#include "host/cimxml/Message.h"
#include "host/cimxml/RequestError.h"
#include "host/http/EventLog.h"
#include "host/http/MhdResponse.h"
#include "host/http/ResourceCheck.h"
#include "host/http/Service.h"

#include <microhttpd.h>
#include <sys/socket.h>

#include <chrono>
#include <exception>
#include <new>
#include <string>
#include <utility>

namespace Host::Http {

namespace {

// RFC 7617, 2 and 2.1.
HttpError unauthorized()
{
    return {MHD_HTTP_UNAUTHORIZED, "sign in with a name and a password", {},
        {{"WWW-Authenticate", R"(Basic realm="sensor-profile", charset="UTF-8")"}}};
}

// RFC 9110, 15.6.4.
HttpError unavailable(
    const std::string& reason, std::chrono::seconds retryAfter = std::chrono::seconds(1))
{
    return {MHD_HTTP_SERVICE_UNAVAILABLE, reason, {},
        {{"Retry-After", std::to_string(retryAfter.count())}}};
}

WorkSlots::Slot takeSlot(WorkSlots& slots)
{
    auto slot = slots.take();
    if (!slot)
        throw unavailable("too many requests are waiting");
    return slot;
}

// Returns whether the client connected to a loopback address.
bool isLoopback(int descriptor)
{
    ::sockaddr_storage raw{};
    auto* const address = reinterpret_cast<::sockaddr*>(&raw);
    ::socklen_t size = sizeof raw;
    return ::getsockname(descriptor, address, &size) == 0 && Address(address).isLoopback();
}

} // namespace

bool Exchange::begin(const RequestHead& head, std::size_t headSize)
{
    try {
        findResource(head);
        bodySize_ = bodySizeOf(head);
        if (headSize > service_.limits.maximumHeader)
            throw HttpError(MHD_HTTP_REQUEST_HEADER_FIELDS_TOO_LARGE,
                "a head holds at most " + std::to_string(service_.limits.maximumHeader) + " bytes");
        checkRequest(head);
        caller_.address = client_.address;
        if (service_.signIns.areDemanded())
            signIn(head);
    } catch (const HttpError& error) {
        error_ = error;
        return refuse();
    }
    return true;
}

void Exchange::findResource(const RequestHead& head)
{
    const std::string path = pathOf(head);
    const auto found = service_.resources.find(path);
    // Operations go to / as well as to /cimom.
    const bool isOperation = path == "/" && head.method != "GET" && head.method != "HEAD";
    if (found == service_.resources.end() || isOperation)
        return;
    resource_ = &found->second.get();
    resourceHead_ = head;
}

void Exchange::checkRequest(const RequestHead& head)
{
    if (resource_ == nullptr) {
        head_ = checkHead(head, bodySize_, service_.limits);
        return;
    }
    checkHost(head);
    checkResourceRequest(head, isLoopback(client_.descriptor));
}

void Exchange::signIn(const RequestHead& head)
{
    const auto field = head.find("Authorization");
    const auto credentials = field ? basicCredentials(*field) : std::nullopt;
    if (!credentials)
        throw unauthorized();
    caller_.principal = credentials->user;
    if (service_.signIns.isKnown(*credentials, client_.address, std::chrono::steady_clock::now()))
        return;
    enter(Phase::working);
    if (!isPasswordRight(*credentials))
        throw unauthorized();
    enter(Phase::receiving);
}

// Returns whether the password is right. For a wrong one, blocks until it may be answered.
bool Exchange::isPasswordRight(const Credentials& credentials)
{
    SignIns& signIns = service_.signIns;
    const auto latest = std::chrono::steady_clock::now() + service_.limits.requestTimeout;
    for (;;) {
        auto slot = takeSlot(resource_ == nullptr ? service_.work : service_.readersSigningIn);
        const auto now = std::chrono::steady_clock::now();
        const auto admission = signIns.admit(client_.network, now);
        if (admission <= now) {
            const auto refusal =
                signIns.tryPassword(credentials, client_.address, client_.network, now);
            slot.reset();
            if (refusal)
                service_.connections.waitUntil(client_, *refusal);
            return !refusal;
        }
        slot.reset();
        if (admission > latest)
            throw unavailable("too many sign-ins have failed",
                std::chrono::ceil<std::chrono::seconds>(admission - now));
        if (!service_.connections.waitUntil(client_, admission))
            throw unavailable(service_.connections.isShuttingDown() ? "the server is ending"
                                                                    : "the client is gone");
    }
}

// REQUIRES: none of the body was received.
bool Exchange::refuse()
{
    // A client that still sends would not see an answer before it has finished, or not at all:
    // libmicrohttpd closes connections that are answered before the end of the body.
    const bool canDiscardBody = bodySize_.bytes.value_or(0) <= 2 * service_.limits.maximumBody;
    if (!canDiscardBody || bodySize_.isAwaited || error_->endsConnection())
        return sendError();
    enter(Phase::receiving);
    state_ = State::discarding;
    return true;
}

bool Exchange::proceed(std::string_view piece)
{
    switch (state_) {
    case State::receiving:
        return piece.empty() ? execute() : receive(piece);
    case State::discarding:
        if (piece.empty())
            return sendError();
        received_ += piece.size();
        return received_ <= 2 * service_.limits.maximumBody;
    default:
        return false;
    }
}

bool Exchange::receive(std::string_view piece)
{
    received_ += piece.size();
    if (received_ <= service_.limits.maximumBody) {
        if (resource_ == nullptr) // the content of a GET has no meaning (RFC 9110, 9.3.1)
            body_.append(piece);
        return true;
    }
    error_.emplace(MHD_HTTP_CONTENT_TOO_LARGE,
        "a body holds at most " + std::to_string(service_.limits.maximumBody) + " bytes");
    body_ = {};
    state_ = State::discarding;
    return true;
}

bool Exchange::execute()
{
    enter(Phase::working);
    try {
        if (resource_ != nullptr) {
            readResource();
            return sendRepresentation();
        }
        runOperation();
        return sendAnswer();
    } catch (const HttpError& error) {
        error_ = error;
    } catch (const CimXml::RequestError& error) {
        error_ = HttpError(error);
    } catch (const std::bad_alloc&) {
        throw;
    } catch (const std::exception& error) {
        report({"execute", "Exchange", __LINE__}, std::string("a request failed: ") + error.what(),
            Severity::error);
        error_ =
            HttpError(MHD_HTTP_INTERNAL_SERVER_ERROR, "the request failed; the log has the reason");
    }
    answer_.drop();
    return sendError();
}

void Exchange::runOperation()
{
    const auto slot = takeSlot(service_.work);
    // The message is destroyed before the answer, which may return the memory of both.
    const auto answer = [this] {
        const CimXml::Message message(body_, service_.limits.maximumDepth);
        body_ = {};
        requireMatch(head_, message);
        return service_.operations.answer(message, caller_);
    };
    answer_.begin(answer(), service_.unsent);
}

void Exchange::readResource()
{
    const auto slot = takeSlot(service_.readers);
    representation_ = resource_->represent(resourceHead_);
    if (representation_.stream)
        stream_.emplace(std::move(representation_.stream), service_.connections, client_,
            [this](Phase phase) { enter(phase); });
}

void Exchange::enter(Phase phase)
{
    service_.connections.enter(client_, phase);
    // libmicrohttpd takes the processing of a request for silence of the client, so that it has no
    // timeout meanwhile. Setting one where there was none restarts it.
    const auto timeout = phase == Phase::working || phase == Phase::waiting
                             ? std::chrono::seconds(0)
                             : service_.limits.idleTimeout;
    ::MHD_set_connection_option(
        &connection_, MHD_CONNECTION_OPTION_TIMEOUT, static_cast<unsigned>(timeout.count()));
}

bool Exchange::sendAnswer()
{
    // The library reads the text or the answer until the request ends, and this exchange with it.
    MhdResponse response =
        answer_.isWhole() ? MhdResponse::whole(answer_.text()) : MhdResponse::inPieces(answer_);
    for (const HeaderField& field : answerFieldsFor(head_))
        response.add(field);
    if (service_.connections.isShuttingDown())
        response.endConnection();
    return send(response, MHD_HTTP_OK, Phase::answering);
}

bool Exchange::sendRepresentation()
{
    MhdResponse response =
        stream_ ? MhdResponse::inPieces(*stream_) : MhdResponse::whole(*representation_.content);
    for (const HeaderField& field : representation_.fields)
        response.add(field);
    if (service_.connections.isShuttingDown())
        response.endConnection();
    return send(response, representation_.status, Phase::fetching);
}

bool Exchange::sendError()
{
    errorText_ = std::string(error_->what()) + "\n";
    MhdResponse response = MhdResponse::whole(errorText_);
    response.add({"Content-Type", "text/plain; charset=utf-8"});
    if (!error_->cimError().empty())
        response.add({"CIMError", error_->cimError()});
    for (const HeaderField& field : error_->fields())
        response.add(field);
    if (error_->endsConnection() || service_.connections.isShuttingDown())
        response.endConnection();
    return send(response, error_->status(), Phase::answering);
}

bool Exchange::send(MhdResponse& response, unsigned status, Phase phase)
{
    if (service_.responses != nullptr)
        service_.responses->add(status);
    if (areDetailsLogged())
        reportDetail({"send", "Exchange", __LINE__}, summary(status));
    state_ = State::answered;
    enter(phase);
    return response.queue(connection_, status);
}

// Returns the status, the client and the call, for the log. The name is the client's claim where
// the error is a refused sign-in.
std::string Exchange::summary(unsigned status) const
{
    std::string text = std::to_string(status) + " to " + client_.address;
    if (!caller_.principal.empty())
        text += ", \"" + caller_.principal + "\"";
    if (resource_ != nullptr)
        text += ", " + resourceHead_.method + " " + resourceHead_.target;
    if (head_.method)
        text += ", " + *head_.method;
    if (head_.object)
        text += " in " + *head_.object;
    if (error_)
        text += std::string(": ") + error_->what();
    return text;
}

} // namespace Host::Http
