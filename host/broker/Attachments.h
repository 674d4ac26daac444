// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Threads of a provider that work for the request of another thread.

#pragma once

#include "host/broker/Arena.h"

#include <memory>
#include <mutex>
#include <unordered_map>

namespace Host {

class Context;

// A prepared context and everything made on its thread lasts until the request has ended
// and the thread was detached, whichever comes later. May be used from any thread.
class Attachments {
public:
    // Called on the request's thread: a copy of the context for another thread. Throws
    // Refusal (CMPI_RC_ERR_FAILED) when no request is active.
    Context& prepare(const Context& context);

    // Called on the other thread. Throws Refusal (CMPI_RC_ERR_FAILED) when this thread works
    // for a request already, or when the context was not prepared or is in use.
    void attach(const Context& context);

    // Called on the attached thread. Throws Refusal (CMPI_RC_ERR_FAILED) when this thread is
    // not attached with the context.
    void detach(const Context& context);

private:
    struct Attachment {
        std::shared_ptr<Arena> arena;
        bool isInUse = false;
    };

    std::mutex mutex_;
    std::unordered_map<const Context*, Attachment> attachments_;
};

} // namespace Host
