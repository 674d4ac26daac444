// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The objects behind the handles of providers. Each CMPI object of the broker is a C++ object that
// contains its own handle, and whose address is the handle's "hdl".

#pragma once

#include "host/broker/Arena.h"

#include <cmpidt.h>
#include <cmpift.h>

#include <cstdint>

namespace Host {

class Object {
public:
    // The numbers are distinctive, so that handles of another origin are recognised.
    enum class Kind : std::uint32_t {
        broker = 0x53504200,
        string,
        array,
        objectPath,
        instance,
        enumeration,
        dateTime,
        context,
        result,
    };

    Kind kind() const noexcept { return kind_; }

    // The name that CMPI gives to the type, such as "CMPIInstance".
    static const char* typeName(Kind kind) noexcept;

    // Returns the object behind any encapsulated CMPI object; null for a null pointer, for one
    // without a handle and for one that is not of this broker.
    static const Object* behind(const void* encapsulated) noexcept;

protected:
    explicit Object(Kind kind) noexcept : kind_(kind) {}

private:
    Kind kind_;
};

// Base of the class Self that implements a HandleType, such as CMPIString. Self declares "static
// const Table functions", the handle's function table.
//
// Objects live in the arena of the request that they are made in, and take memory from the
// thread's current one when they change.
template <typename Self, typename HandleType, Object::Kind itsKind>
class Encapsulated : public Object {
public:
    using Handle = HandleType;
    static constexpr Kind kindOfSelf = itsKind;

    // Returns the object behind a handle; null for a null handle, one without an object and one
    // of another kind. CMPI passes objects as const even to functions that change them.
    static Self* of(const Handle* handle) noexcept
    {
        const Object* const object = behind(handle);
        if (object == nullptr || object->kind() != itsKind)
            return nullptr;
        return const_cast<Self*>(static_cast<const Self*>(object));
    }

    // A handle contains the address of its object.
    Encapsulated(const Encapsulated&) = delete;
    Encapsulated& operator=(const Encapsulated&) = delete;

    // Returns the handle by which providers refer to the object.
    Handle* handle() const noexcept { return &handle_; }

protected:
    Encapsulated() noexcept : Object(itsKind), handle_{static_cast<Object*>(this), &Self::functions}
    {
    }
    ~Encapsulated() = default;

private:
    mutable Handle handle_;
};

} // namespace Host
