// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/StreamedAnswer.h"

#include "host/http/Connections.h"
#include "host/http/EventLog.h"

#include <microhttpd.h>

namespace Host::Http {

StreamedAnswer::StreamedAnswer(
    std::unique_ptr<Stream> stream, Connections& connections, ClientConnection& client, Enter enter)
    : stream_(std::move(stream)), connections_(connections), client_(client),
      enter_(std::move(enter))
{
    if (!connections_.beginStream(client_, *stream_))
        throw HttpError::closing(MHD_HTTP_SERVICE_UNAVAILABLE, "clients have too many streams open",
            {{"Retry-After", "10"}});
}

StreamedAnswer::~StreamedAnswer()
{
    connections_.endStream(client_);
}

::ssize_t StreamedAnswer::read(char* to, std::size_t room) noexcept
{
    try {
        while (!piece_ || sent_ == piece_->size()) {
            piece_.reset();
            sent_ = 0;
            enter_(Phase::waiting);
            piece_ = stream_->next();
            enter_(Phase::fetching);
            if (!piece_)
                return MHD_CONTENT_READER_END_OF_STREAM;
        }
        if (sent_ > 0)
            enter_(Phase::fetching); // the client takes the piece, if slowly
    } catch (...) {
        report({"read", "StreamedAnswer", __LINE__}, "a stream broke off");
        return MHD_CONTENT_READER_END_WITH_ERROR;
    }
    const std::size_t count = piece_->copy(to, room, sent_);
    sent_ += count;
    return static_cast<::ssize_t>(count);
}

} // namespace Host::Http
