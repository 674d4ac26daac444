// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What every object behind a CMPI handle has in common: its kind, and the arena it lives in.

#pragma once

#include "host/broker/Arena.h"

#include <cmpidt.h>
#include <cmpift.h>

#include <cstdint>
#include <memory>

namespace Host {

class Object {
public:
    // Distinctive numbers: a handle of another origin is not taken for one of ours.
    enum class Kind : std::uint32_t {
        broker = 0x53504200,
        string,
        array,
        objectPath,
        instance,
        enumeration,
        dateTime,
        arguments,
        context,
        result,
        error,
    };

    Kind kind() const noexcept { return kind_; }

    // The name CMPI gives to the type, such as "CMPIInstance".
    static const char* typeName(Kind kind) noexcept;

    // The object behind any encapsulated CMPI object; null for none, a handle-less one, or
    // one that is not ours.
    static const Object* behind(const void* encapsulated) noexcept;

protected:
    Object(Kind kind, Arena* home) noexcept : kind_(kind), home_(home) {}

    Kind kind_;
    bool isClone_ = false; // owns its home
    Arena* home_;
};

// The layout every encapsulated object begins with, whatever its function table.
struct AnyHandle {
    const void* hdl;
    const void* ft;
};

// Base of the class Self that stands behind a HandleType, such as CMPIString. Self declares
// "static const Table functions", the handle's function table, and "copiedTo(Arena&)".
template <typename Self, typename HandleType, Object::Kind itsKind>
class Encapsulated : public Object {
public:
    using Handle = HandleType;
    static constexpr Kind kindOfSelf = itsKind;

    // The object behind a handle; null for a null handle, a handle without an object, or an
    // object of another kind. CMPI passes objects as const also where it lets them be
    // changed.
    static Self* of(const Handle* handle) noexcept
    {
        const Object* const object = behind(handle);
        if (object == nullptr || object->kind() != itsKind)
            return nullptr;
        return const_cast<Self*>(static_cast<const Self*>(object));
    }

    // What is handed to a provider.
    Handle* handle() const noexcept { return &handle_; }

    // A copy with an arena of its own, which lives until it is released.
    Self& cloned() const
    {
        auto home = std::make_unique<Arena>(Arena::Purpose::clone);
        Self& clone = static_cast<const Self*>(this)->copiedTo(*home);
        static_cast<Encapsulated&>(clone).isClone_ = true;
        home.release(); // the clone owns it now
        return clone;
    }

    // Ends a clone. Any other object goes with its request, releasing it changes nothing.
    void release()
    {
        if (isClone_)
            std::unique_ptr<Arena>{home_}.reset();
    }

protected:
    explicit Encapsulated(Arena* home) noexcept
        : Object(itsKind, home), handle_{static_cast<Object*>(this), &Self::functions}
    {
    }

    // Handles point back at their object.
    Encapsulated(const Encapsulated&) = delete;
    Encapsulated& operator=(const Encapsulated&) = delete;

    // Where the object takes memory when it changes: a clone's belongs to the clone, any
    // other object's to the request, on whichever of its threads.
    Arena& memory() const
    {
        return home_ != nullptr && home_->isCloneHome() ? *home_ : Arena::required();
    }

private:
    mutable Handle handle_;
};

} // namespace Host
