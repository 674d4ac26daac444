// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Resource.h"

#include <sys/types.h>

#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <utility>

namespace Host::Http {

class Connections;
enum class Phase;
struct ClientConnection;

// An answer that is a stream, which the shutdown of the connections ends, and so does the client
// when it closes its connection. Not thread-safe.
class StreamedAnswer {
public:
    // Has the connection enter a phase.
    using Enter = std::function<void(Phase)>;

    // Throws HttpError where clients have too many streams open. The connections and the client
    // must outlive it.
    StreamedAnswer(std::unique_ptr<Stream> stream, Connections& connections,
        ClientConnection& client, Enter enter);
    ~StreamedAnswer();
    StreamedAnswer(const StreamedAnswer&) = delete;
    StreamedAnswer& operator=(const StreamedAnswer&) = delete;

    // Reads the next part, for which it blocks, as an MHD_ContentReaderCallback does.
    ::ssize_t read(char* to, std::size_t room) noexcept;

private:
    const std::unique_ptr<Stream> stream_;
    Connections& connections_;
    ClientConnection& client_;
    const Enter enter_;
    std::shared_ptr<const std::string> piece_;
    std::size_t sent_ = 0; // bytes of the piece
};

} // namespace Host::Http
