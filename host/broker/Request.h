// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The scope of one request: while it lasts, this thread can make CMPI objects.

#pragma once

#include "host/broker/Arena.h"
#include "host/broker/Context.h"

#include <memory>
#include <string_view>

namespace Host {

class Broker;
class Instance;
class ObjectPath;

// All objects made while it lasts go with it, unless somebody holds on to its arena. A request
// made while another one is active on the thread, as in an up-call, uses the arena of that one:
// its objects can be handed to the caller and go with the outermost request.
//
// Stays on the stack of its thread; the last one made ends first.
class Request {
public:
    // The broker must outlive the request.
    explicit Request(const Broker& broker);
    ~Request();
    Request(const Request&) = delete;
    Request& operator=(const Request&) = delete;

    Arena& arena() const noexcept { return arena_; }
    // For objects that are to outlive the request: they do while somebody holds this. Null for a
    // request within another one.
    const std::shared_ptr<Arena>& shareArena() const noexcept { return own_; }
    Context& context() noexcept { return context_; }

    // Objects for the provider's arguments.
    ObjectPath& makePath(std::string_view nameSpace, std::string_view className) const;
    Instance& makeInstance(const ObjectPath& path) const;

private:
    const Broker& broker_;
    std::shared_ptr<Arena> own_; // of the outermost request
    Arena& arena_;
    Context context_;
};

} // namespace Host
