// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A client that sends exactly the given bytes and parses HTTP/1.1 answers.

#pragma once

#include <sys/types.h>

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <map>
#include <string>
#include <string_view>

namespace Testing {

struct HttpReply {
    int status = 0;
    std::map<std::string, std::string> fields; // by name in lower case
    std::string body;

    // Returns the value of a field; an empty text when there is none.
    std::string field(const std::string& name) const
    {
        const auto found = fields.find(name);
        return found == fields.end() ? std::string() : found->second;
    }
};

// Every function throws std::runtime_error when it fails or exceeds the timeout.
class HttpClient {
public:
    static constexpr std::chrono::seconds timeout{20};

    explicit HttpClient(std::uint16_t port, const std::string& host = "127.0.0.1");
    virtual ~HttpClient();
    HttpClient(HttpClient&& other) noexcept;
    HttpClient& operator=(HttpClient&& other) noexcept;

    void send(std::string_view bytes);
    // Closes the sending direction of the connection.
    void endSending();
    // Returns false when the server does not receive all.
    bool trySend(std::string_view bytes);

    // Returns the next final answer; interim answers are skipped.
    HttpReply receive();
    // Returns whether an answer, or a part of one, arrives within the time.
    bool hasReplyWithin(std::chrono::milliseconds time);
    // Returns the next bytes, at least one; an empty text when the server has closed the
    // connection.
    std::string receiveSome();
    // Waits until the server closes the connection. Returns false when data arrives instead.
    bool isClosed();
    // Closes the connection with a reset.
    void closeHard();

protected:
    // Both return what send() and recv() on the socket return.
    virtual ::ssize_t write(const char* bytes, std::size_t count);
    virtual ::ssize_t read(char* bytes, std::size_t count);

    int descriptor() const { return descriptor_; }

private:
    std::string line();
    std::string exactly(std::size_t count);
    std::string chunks();
    bool readMore();
    bool waitFor(short events, std::chrono::milliseconds time) const;

    int descriptor_;
    std::string received_;
};

} // namespace Testing
