// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An answer on its way to the client.

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "host/http/UnsentObjects.h"

#include <sys/types.h>

#include <cstddef>
#include <memory>
#include <string>

namespace Host::Http {

// Used by one thread at a time.
class PendingAnswer {
public:
    // Writes the beginning, which is all of it where that is short; the objects of what is left
    // count among the unsent ones. Throws HttpError where there are too many of those, and
    // std::bad_alloc.
    void begin(std::unique_ptr<CimXml::Answer> answer, UnsentObjects& unsent);
    // As if it had never begun.
    void drop();

    // Whether nothing is left to be written: all of it is in the text.
    bool isWhole() const { return answer_ == nullptr; }
    const std::string& text() const { return text_; }

    // The next part of one that is not whole; what the library expects of a content reader.
    ::ssize_t read(char* to, std::size_t room) noexcept;

private:
    void end();

    UnsentObjects::Share share_;
    std::unique_ptr<CimXml::Answer> answer_; // goes before its share
    std::string text_;
    std::size_t sent_ = 0; // of the text
};

} // namespace Host::Http
