// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "host/http/UnsentObjects.h"

#include <sys/types.h>

#include <cstddef>
#include <memory>
#include <string>

namespace Host::Http {

// An answer of which the client has yet to fetch a part. Not thread-safe.
class PendingAnswer {
public:
    // Writes the beginning of the answer, or all of a short one; the objects of the rest count
    // among the unsent ones. Throws HttpError where those are too many, and std::bad_alloc.
    void begin(std::unique_ptr<CimXml::Response> answer, UnsentObjects& unsent);
    // Destroys the objects that are not written yet.
    void drop();

    // Returns whether the text holds all of the answer.
    bool isWhole() const { return answer_ == nullptr; }
    const std::string& text() const { return text_; }

    // Reads the next part of an answer that is not whole, as an MHD_ContentReaderCallback does.
    ::ssize_t read(char* to, std::size_t room) noexcept;

private:
    UnsentObjects::Share share_;
    std::unique_ptr<CimXml::Response> answer_; // destroyed before its share
    std::string text_;
    std::size_t sent_ = 0; // bytes of the text
};

} // namespace Host::Http
