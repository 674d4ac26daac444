// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Attachments.h"

#include "host/broker/Context.h"
#include "host/broker/Refusal.h"

namespace Host {

Context& Attachments::prepare(const Context& context)
{
    auto arena = std::make_shared<Arena>();
    Context& prepared = context.copiedTo(*arena);
    Arena::required().adopt(arena);
    const std::lock_guard lock(mutex_);
    attachments_[&prepared] = {std::move(arena)};
    return prepared;
}

void Attachments::attach(const Context& context)
{
    if (Arena::current() != nullptr)
        throw Refusal(CMPI_RC_ERR_FAILED, "this thread works for a request already");
    const std::lock_guard lock(mutex_);
    const auto found = attachments_.find(&context);
    if (found == attachments_.end() || found->second.isInUse)
        throw Refusal(CMPI_RC_ERR_FAILED, "the context was not prepared for this thread");
    found->second.isInUse = true;
    Arena::makeCurrent(found->second.arena.get());
}

void Attachments::detach(const Context& context)
{
    std::shared_ptr<Arena> last; // goes after the lock
    const std::lock_guard lock(mutex_);
    const auto found = attachments_.find(&context);
    if (found == attachments_.end() || found->second.arena.get() != Arena::current())
        throw Refusal(CMPI_RC_ERR_FAILED, "this thread is not attached with the context");
    last = std::move(found->second.arena);
    attachments_.erase(found);
    Arena::makeCurrent(nullptr);
}

} // namespace Host
