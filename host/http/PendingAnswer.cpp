// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/PendingAnswer.h"

#include "host/http/EventLog.h"
#include "host/http/HttpError.h"

#include <microhttpd.h>

#include <algorithm>
#include <cstring>
#include <utility>

namespace Host::Http {

namespace {

// The part of an answer that is written before it is sent. A shorter answer has a known length.
constexpr std::size_t answerHead = std::size_t{64} << 10;

} // namespace

void PendingAnswer::begin(std::unique_ptr<CimXml::Response> answer, UnsentObjects& unsent)
{
    answer_ = std::move(answer);
    while (text_.size() < answerHead)
        if (!answer_->append(text_))
            return drop();
    share_ = unsent.hold(answer_->heldObjects());
    if (share_)
        return;
    drop();
    throw HttpError::closing(MHD_HTTP_SERVICE_UNAVAILABLE,
        "clients have yet to fetch answers with so many objects that there is no room for more",
        {{"Retry-After", "1"}});
}

void PendingAnswer::drop()
{
    answer_.reset();
    share_.reset();
}

::ssize_t PendingAnswer::read(char* to, std::size_t room) noexcept
{
    try {
        // The rest of a piece is sent with the next one: libmicrohttpd makes a packet of every
        // part, however short.
        if (answer_ && text_.size() - sent_ < room) {
            text_.erase(0, sent_);
            sent_ = 0;
        }
        while (answer_ && text_.size() < room)
            if (!answer_->append(text_))
                drop();
    } catch (...) {
        report({"read", "PendingAnswer", __LINE__}, "an answer broke off");
        return MHD_CONTENT_READER_END_WITH_ERROR;
    }
    if (sent_ == text_.size())
        return MHD_CONTENT_READER_END_OF_STREAM;
    const std::size_t count = std::min(room, text_.size() - sent_);
    std::memcpy(to, text_.data() + sent_, count);
    sent_ += count;
    return static_cast<::ssize_t>(count);
}

} // namespace Host::Http
