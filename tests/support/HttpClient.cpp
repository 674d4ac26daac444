// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/support/HttpClient.h"

#include <netdb.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cctype>
#include <cerrno>
#include <memory>
#include <stdexcept>
#include <system_error>
#include <utility>

namespace Testing {

namespace {

[[noreturn]] void failByErrno(const char* what)
{
    throw std::system_error(errno, std::system_category(), what);
}

std::string trimmedLine(const std::string& text)
{
    const auto first = text.find_first_not_of(" \t");
    if (first == std::string::npos)
        return "";
    return text.substr(first, text.find_last_not_of(" \t\r") - first + 1);
}

std::string inLowerCase(std::string text)
{
    std::transform(text.begin(), text.end(), text.begin(),
        [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return text;
}

} // namespace

HttpClient::HttpClient(std::uint16_t port, const std::string& host)
{
    addrinfo hints{};
    hints.ai_flags = AI_NUMERICHOST | AI_NUMERICSERV;
    hints.ai_socktype = SOCK_STREAM;
    addrinfo* found = nullptr;
    if (::getaddrinfo(host.c_str(), std::to_string(port).c_str(), &hints, &found) != 0)
        throw std::runtime_error(host + " is no address");
    const std::unique_ptr<addrinfo, void (*)(addrinfo*)> owner(found, ::freeaddrinfo);
    descriptor_ = ::socket(found->ai_family, SOCK_STREAM | SOCK_CLOEXEC, 0);
    if (descriptor_ < 0)
        failByErrno("socket");
    if (::connect(descriptor_, found->ai_addr, found->ai_addrlen) != 0) {
        const int error = errno;
        ::close(descriptor_);
        errno = error;
        failByErrno("connect");
    }
}

HttpClient::HttpClient(HttpClient&& other) noexcept
    : descriptor_(std::exchange(other.descriptor_, -1)), received_(std::move(other.received_))
{
}

HttpClient& HttpClient::operator=(HttpClient&& other) noexcept
{
    std::swap(descriptor_, other.descriptor_);
    std::swap(received_, other.received_);
    return *this;
}

HttpClient::~HttpClient()
{
    if (descriptor_ >= 0)
        ::close(descriptor_);
}

void HttpClient::send(std::string_view bytes)
{
    if (!trySend(bytes))
        failByErrno("send");
}

bool HttpClient::trySend(std::string_view bytes)
{
    while (!bytes.empty()) {
        if (!waitFor(POLLOUT, timeout))
            throw std::runtime_error("the server does not read");
        const ::ssize_t sent = write(bytes.data(), bytes.size());
        if (sent < 0 && (errno == EAGAIN || errno == EINTR))
            continue;
        if (sent < 0)
            return false;
        bytes.remove_prefix(static_cast<std::size_t>(sent));
    }
    return true;
}

::ssize_t HttpClient::write(const char* bytes, std::size_t count)
{
    return ::send(descriptor_, bytes, count, MSG_NOSIGNAL | MSG_DONTWAIT);
}

::ssize_t HttpClient::read(char* bytes, std::size_t count)
{
    return ::recv(descriptor_, bytes, count, 0);
}

void HttpClient::endSending()
{
    ::shutdown(descriptor_, SHUT_WR);
}

HttpReply HttpClient::receive()
{
    HttpReply reply;
    do {
        reply = {};
        const std::string first = line();
        if (!first.starts_with("HTTP/1.1 "))
            throw std::runtime_error("no answer: " + first);
        reply.status = std::stoi(first.substr(9));
        for (std::string field = line(); !field.empty(); field = line()) {
            const auto colon = field.find(':');
            if (colon == std::string::npos)
                throw std::runtime_error("no header field: " + field);
            reply.fields[inLowerCase(field.substr(0, colon))] =
                trimmedLine(field.substr(colon + 1));
        }
    } while (reply.status == 100);
    if (reply.field("transfer-encoding") == "chunked")
        reply.body = chunks();
    else
        reply.body = reply.status == 304 ? "" : exactly(std::stoul(reply.field("content-length")));
    return reply;
}

bool HttpClient::hasReplyWithin(std::chrono::milliseconds time)
{
    return !received_.empty() || waitFor(POLLIN, time);
}

std::string HttpClient::receiveSome()
{
    if (received_.empty())
        readMore();
    return std::exchange(received_, {});
}

bool HttpClient::isClosed()
{
    return received_.empty() && !readMore();
}

void HttpClient::closeHard()
{
    const linger atOnce{1, 0};
    ::setsockopt(descriptor_, SOL_SOCKET, SO_LINGER, &atOnce, sizeof atOnce);
    ::close(std::exchange(descriptor_, -1));
}

std::string HttpClient::line()
{
    for (;;) {
        const auto end = received_.find("\r\n");
        if (end != std::string::npos) {
            const std::string text = received_.substr(0, end);
            received_.erase(0, end + 2);
            return text;
        }
        if (!readMore())
            throw std::runtime_error("the answer broke off behind: " + received_);
    }
}

std::string HttpClient::exactly(std::size_t count)
{
    while (received_.size() < count)
        if (!readMore())
            throw std::runtime_error("the body broke off");
    const std::string text = received_.substr(0, count);
    received_.erase(0, count);
    return text;
}

std::string HttpClient::chunks()
{
    std::string all;
    for (;;) {
        const std::size_t size = std::stoul(line(), nullptr, 16);
        all += exactly(size);
        if (!line().empty())
            throw std::runtime_error("a chunk has no end");
        if (size == 0)
            return all;
    }
}

bool HttpClient::readMore()
{
    if (!waitFor(POLLIN, timeout))
        throw std::runtime_error("nothing came");
    std::array<char, 65536> piece{};
    const ::ssize_t got = read(piece.data(), piece.size());
    if (got < 0 && errno != ECONNRESET)
        failByErrno("recv");
    if (got <= 0)
        return false;
    received_.append(piece.data(), static_cast<std::size_t>(got));
    return true;
}

bool HttpClient::waitFor(short events, std::chrono::milliseconds time) const
{
    pollfd wanted{descriptor_, events, 0};
    return ::poll(&wanted, 1, static_cast<int>(time.count())) > 0;
}

} // namespace Testing
