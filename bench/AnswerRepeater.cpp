// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "bench/AnswerRepeater.h"

#include <netinet/in.h>
#include <netinet/tcp.h>
#include <sys/socket.h>

#include <array>
#include <cerrno>
#include <string_view>
#include <system_error>

namespace Bench {

namespace {

void require(bool succeeded)
{
    if (!succeeded)
        throw std::system_error(errno, std::generic_category(), "a listening socket");
}

// Returns false where the client has closed the connection.
bool receive(int descriptor, std::size_t count)
{
    std::array<char, 4096> buffer{};
    while (count != 0) {
        const ::ssize_t received = ::recv(descriptor, buffer.data(), buffer.size(), 0);
        if (received <= 0)
            return false;
        count -= static_cast<std::size_t>(received);
    }
    return true;
}

bool send(int descriptor, std::string_view bytes)
{
    while (!bytes.empty()) {
        const ::ssize_t sent = ::send(descriptor, bytes.data(), bytes.size(), MSG_NOSIGNAL);
        if (sent < 0)
            return false;
        bytes.remove_prefix(static_cast<std::size_t>(sent));
    }
    return true;
}

} // namespace

AnswerRepeater::AnswerRepeater(std::size_t requestSize, const std::string& body)
    : requestSize_(requestSize),
      answer_(
          "HTTP/1.1 200 OK\r\nContent-Length: " + std::to_string(body.size()) + "\r\n\r\n" + body),
      socket_(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0))
{
    require(socket_.isOpen());
    ::sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    ::socklen_t size = sizeof address;
    auto* const raw = reinterpret_cast<::sockaddr*>(&address);
    require(::bind(socket_.number(), raw, size) == 0 && ::listen(socket_.number(), 1) == 0 &&
            ::getsockname(socket_.number(), raw, &size) == 0);
    port_ = ntohs(address.sin_port);
    thread_ = std::jthread([this] { serve(); });
}

AnswerRepeater::~AnswerRepeater()
{
    ::shutdown(socket_.number(), SHUT_RDWR); // where no client has connected
    thread_.join();
}

void AnswerRepeater::serve() const
{
    const Vorn::Descriptor client(::accept(socket_.number(), nullptr, nullptr));
    const int on = 1;
    ::setsockopt(client.number(), IPPROTO_TCP, TCP_NODELAY, &on, sizeof on);
    while (receive(client.number(), requestSize_) && send(client.number(), answer_)) {}
}

} // namespace Bench
