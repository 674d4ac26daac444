// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The scope of one request, within which its thread can make CMPI objects.

#pragma once

#include "host/broker/Arena.h"
#include "host/broker/Context.h"

#include <memory>
#include <string_view>

namespace Host {

class Broker;
class Instance;
class ObjectPath;

// The objects made during a request are destroyed with it, unless its arena is shared. A request
// made while another one is active on the thread, as in an up-call, uses the arena of that one: its
// objects can be returned to the caller and are destroyed with the outermost request.
//
// REQUIRES: a request stays on its thread; the last one made on it is destroyed first.
class Request {
public:
    // The broker must outlive the request.
    explicit Request(const Broker& broker);
    ~Request();
    Request(const Request&) = delete;
    Request& operator=(const Request&) = delete;

    Arena& arena() const noexcept { return arena_; }
    // Returns the arena, whose objects live as long as a copy of this pointer; null for a request
    // within another one.
    const std::shared_ptr<Arena>& shareArena() const noexcept { return own_; }
    Context& context() noexcept { return context_; }

    // Makes a path for the arguments of a provider call.
    ObjectPath& makePath(std::string_view nameSpace, std::string_view className) const;
    Instance& makeInstance(const ObjectPath& path) const;

private:
    const Broker& broker_;
    std::shared_ptr<Arena> own_; // of the outermost request
    Arena& arena_;
    Context context_;
};

} // namespace Host
