// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/utilities/Descriptor.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <thread>

namespace Bench {

// A server that sends one answer to each request of one client and does nothing else: what a client
// measures with it is the transport.
class AnswerRepeater {
public:
    // The size is that of a request with its head; the body, that of the answer. Throws
    // std::system_error.
    AnswerRepeater(std::size_t requestSize, const std::string& body);
    // REQUIRES: the client has closed its connection.
    ~AnswerRepeater();
    AnswerRepeater(const AnswerRepeater&) = delete;
    AnswerRepeater& operator=(const AnswerRepeater&) = delete;

    std::uint16_t port() const { return port_; }

private:
    void serve() const;

    const std::size_t requestSize_;
    const std::string answer_;
    const Vorn::Descriptor socket_;
    std::uint16_t port_ = 0;
    std::jthread thread_;
};

} // namespace Bench
