// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A client that sends exactly the bytes it is told to, and reads answers of HTTP/1.1.

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

    // Empty when it is not there.
    std::string field(const std::string& name) const
    {
        const auto found = fields.find(name);
        return found == fields.end() ? std::string() : found->second;
    }
};

// Every failure and everything that exceeds the timeout throws std::runtime_error.
class HttpClient {
public:
    static constexpr std::chrono::seconds timeout{20};

    explicit HttpClient(std::uint16_t port, const std::string& host = "127.0.0.1");
    virtual ~HttpClient();
    HttpClient(HttpClient&& other) noexcept;
    HttpClient& operator=(HttpClient&& other) noexcept;

    void send(std::string_view bytes);
    // No more will be sent.
    void endSending();
    // False when the server does not take all.
    bool trySend(std::string_view bytes);

    // The next answer; interim ones are passed over.
    HttpReply receive();
    // Whether an answer, or a part of one, comes within the time.
    bool hasReplyWithin(std::chrono::milliseconds time);
    // The next bytes, at least one; empty at the end of the connection.
    std::string receiveSome();
    // Waits for the end of the connection; false when something comes instead.
    bool isClosed();
    // Sends a reset when it is closed.
    void closeHard();

protected:
    // As send and recv on the socket.
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
