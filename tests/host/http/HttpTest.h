// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A server with operations that the test defines, and requests to it.

#pragma once

#include "host/cimxml/Message.h"
#include "host/http/Certificate.h"
#include "host/http/ListenPolicy.h"
#include "host/http/ListeningSocket.h"
#include "host/http/Passwords.h"
#include "host/http/ResponseCounts.h"
#include "host/http/Server.h"
#include "tests/support/CimCall.h"
#include "tests/support/HttpClient.h"
#include "tests/support/WaitUntil.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace HttpTests {

using Host::CimXml::Caller;
using Host::CimXml::Message;
using Testing::cimCall;
using Testing::cimFields;
using Testing::cimRequest;
using Testing::HttpClient;
using Testing::HttpReply;
using Testing::lengthField;

// A response of the given number of pieces, each of the given size.
class PiecewiseResponse : public Host::CimXml::Response {
public:
    PiecewiseResponse(std::string piece, std::size_t count, std::atomic<int>& alive)
        : piece_(std::move(piece)), left_(count), alive_(alive)
    {
        ++alive_;
    }
    ~PiecewiseResponse() override { --alive_; }

    bool append(std::string& out) override
    {
        if (left_ == 0)
            return false;
        --left_;
        out += piece_;
        return true;
    }

    std::size_t heldObjects() const noexcept override { return left_; }

private:
    std::string piece_;
    std::size_t left_;
    std::atomic<int>& alive_;
};

// Answers with <answer/> unless a test sets another answer.
class StubOperations : public Host::CimXml::OperationHandler {
public:
    using Work = std::function<void(const Message&, const Caller&)>;

    std::unique_ptr<Host::CimXml::Response> answer(
        const Message& message, const Caller& caller) override
    {
        ++calls;
        const auto [work, text, repetitions] = plan();
        if (work)
            work(message, caller);
        ++finished;
        return std::make_unique<PiecewiseResponse>(text, repetitions, answersAlive);
    }

    // Sets what each operation does before it answers.
    void doFirst(Work work)
    {
        const std::lock_guard lock(mutex_);
        plan_.work = std::move(work);
    }
    void answerWith(std::string text, std::size_t repetitions = 1)
    {
        const std::lock_guard lock(mutex_);
        plan_.text = std::move(text);
        plan_.repetitions = repetitions;
    }

    std::atomic<int> calls{0};
    std::atomic<int> finished{0}; // incremented after the work
    std::atomic<int> answersAlive{0};

private:
    struct Plan {
        Work work{};
        std::string text = "<answer/>";
        std::size_t repetitions = 1;
    };

    Plan plan()
    {
        const std::lock_guard lock(mutex_);
        return plan_;
    }

    std::mutex mutex_;
    Plan plan_;
};

inline const std::string usualFields = cimFields("EnumerateClasses");

inline std::string post(const std::string& moreFields = "",
    const std::string& body = cimCall("EnumerateClasses"), const std::string& path = "/cimom")
{
    return "POST " + path + " HTTP/1.1\r\n" + usualFields + lengthField(body) + moreFields +
           "\r\n" + body;
}

// Sends the head of a request and waits until the server asks for the rest.
inline void beginPost(HttpClient& client)
{
    client.send("POST /cimom HTTP/1.1\r\n" + usualFields +
                lengthField(cimCall("EnumerateClasses")) + "Expect: 100-continue\r\n\r\n");
    EXPECT_THAT(client.receiveSome(), testing::StartsWith("HTTP/1.1 100 "));
}

// Returns the status of the answer to such a request.
inline int finishPost(HttpClient& client)
{
    client.send(cimCall("EnumerateClasses"));
    return client.receive().status;
}

class HttpTest : public testing::Test {
protected:
    void start(std::vector<Host::Http::Endpoint> endpoints = {{{"127.0.0.1", 0}}})
    {
        auto sockets = Host::Http::listenOn(std::move(endpoints));
        port = sockets.front().address().port();
        server.emplace(
            operations, std::move(sockets), limits, certificate, passwords, resources, &responses);
    }

    HttpClient connect() const { return HttpClient(port); }

    HttpReply ask(const std::string& request)
    {
        HttpClient client = connect();
        client.send(request);
        return client.receive();
    }

    // Expects all answers to be destroyed within a timeout.
    void expectNoAnswerAlive() const
    {
        EXPECT_TRUE(Testing::waitUntil([this] { return operations.answersAlive == 0; }));
    }

    StubOperations operations;
    Host::Http::Resources resources;
    Host::Http::ResponseCounts responses;
    Host::Http::Limits limits;
    std::shared_ptr<const Host::Http::Certificate> certificate;
    std::shared_ptr<const Host::Http::Passwords> passwords;
    std::optional<Host::Http::Server> server;
    std::uint16_t port = 0;
};

} // namespace HttpTests
