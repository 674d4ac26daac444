// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Slot<function> fills one slot of a CMPI function table with an ordinary C++ function that takes a
// reference to the object behind the handle. It implements the common parts of all slots: it
// returns CMPI_RC_ERR_INVALID_HANDLE for a null object and one without a handle, converts
// exceptions to statuses, and sets the status, whose pointer may be null.

#pragma once

#include "host/broker/Object.h"
#include "host/broker/Refusal.h"

#include <cmpidt.h>
#include <cmpift.h>

#include <exception>
#include <functional>
#include <string>
#include <string_view>
#include <tuple>
#include <type_traits>
#include <utility>

namespace Host {

// Returns a status with the reason as its message, or without a message when no request is active.
CMPIStatus makeStatus(CMPIrc code, const char* reason) noexcept;

// The value that a slot returns when it fails.
template <typename Answer>
constexpr Answer nothing() noexcept
{
    if constexpr (std::is_same_v<Answer, CMPIData>)
        return CMPIData{CMPI_null, CMPI_nullValue | CMPI_notFound, {}};
    else
        return Answer();
}

namespace Detail {

template <typename Function>
struct SelfOf;
template <typename Answer, typename Self, typename... Rest, bool nothrow>
struct SelfOf<Answer (*)(Self&, Rest...) noexcept(nothrow)> {
    using type = Self;
};
template <typename Answer, typename Self, typename... Rest, bool nothrow>
struct SelfOf<Answer (Self::*)(Rest...) noexcept(nothrow)> {
    using type = Self;
};
template <typename Answer, typename Self, typename... Rest, bool nothrow>
struct SelfOf<Answer (Self::*)(Rest...) const noexcept(nothrow)> {
    using type = Self;
};

// Converts what a C++ function returns to the type of the slot: objects become handles, numbers are
// cast.
template <typename Answer, typename Given>
Answer answerOf(Given&& given)
{
    if constexpr (std::is_convertible_v<Given, Answer> && !std::is_arithmetic_v<Answer>)
        return std::forward<Given>(given);
    else if constexpr (std::is_arithmetic_v<Answer>)
        return static_cast<Answer>(given);
    else
        return given.handle();
}

template <typename... Arguments>
constexpr bool endsInStatus()
{
    if constexpr (sizeof...(Arguments) == 0)
        return false;
    else
        return std::is_same_v<
            std::tuple_element_t<sizeof...(Arguments) - 1, std::tuple<Arguments...>>, CMPIStatus*>;
}

inline CMPIStatus* statusIn(CMPIStatus* status)
{
    return status;
}
template <typename Other>
CMPIStatus* statusIn(const Other&)
{
    return nullptr;
}

// Returns the status pointer among a slot's arguments; null when there is none.
template <typename... Arguments>
CMPIStatus* statusOf(const Arguments&... arguments)
{
    CMPIStatus* found = nullptr;
    ((found = found == nullptr ? statusIn(arguments) : found), ...);
    return found;
}

// Sets the status and returns what the slot returns with it. The functions that return an int
// return a code; void functions cannot report a failure.
template <typename Answer>
Answer refuse(CMPIStatus* status, CMPIrc code, const char* reason)
{
    const CMPIStatus outcome = makeStatus(code, reason);
    if (status != nullptr)
        *status = outcome;
    if constexpr (std::is_same_v<Answer, CMPIStatus>)
        return outcome;
    else if constexpr (std::is_same_v<Answer, int>)
        return code;
    else
        return nothing<Answer>();
}

// Pointers to a slot's function; they deduce its signature from the table that it is put into.
template <typename Answer, typename... Arguments>
using Pointer = Answer (*)(Arguments...);
template <typename Answer, typename... Arguments>
using VariadicPointer = Answer (*)(Arguments..., ...);

} // namespace Detail

// The function is called with the slot's arguments except a trailing CMPIStatus*. It throws Refusal
// to return any code but CMPI_RC_OK.
template <auto function>
class Slot {
    using Self = typename Detail::SelfOf<decltype(function)>::type;

    template <typename Answer, typename Tuple, std::size_t... index>
    static Answer invoke(Self& self, const Tuple& arguments, std::index_sequence<index...>)
    {
        using Given = decltype(std::invoke(function, self, std::get<index>(arguments)...));
        if constexpr (std::is_void_v<Given>) {
            std::invoke(function, self, std::get<index>(arguments)...);
            return nothing<Answer>();
        } else {
            return Detail::answerOf<Answer, Given>(
                std::invoke(function, self, std::get<index>(arguments)...));
        }
    }

public:
    template <typename Answer, typename Handle, typename... Arguments>
    static Answer call(Handle* handle, Arguments... arguments)
    {
        constexpr std::size_t count =
            sizeof...(Arguments) - (Detail::endsInStatus<Arguments...>() ? 1 : 0);
        const std::tuple<Arguments...> all{arguments...};
        CMPIStatus* const status = Detail::statusOf(arguments...);
        // Only standard exceptions: a cancelled thread unwinds with another kind.
        try {
            Self* const self = Self::of(handle);
            if (self == nullptr)
                throw Refusal(CMPI_RC_ERR_INVALID_HANDLE, "no object behind the handle");
            if (status != nullptr)
                *status = {CMPI_RC_OK, nullptr};
            return invoke<Answer>(*self, all, std::make_index_sequence<count>{});
        } catch (const Refusal& refusal) {
            return Detail::refuse<Answer>(status, refusal.code(), refusal.what());
        } catch (const std::exception& failure) {
            return Detail::refuse<Answer>(status, CMPI_RC_ERR_FAILED, failure.what());
        }
    }

    template <typename Answer, typename Handle, typename... Arguments>
    constexpr operator Detail::Pointer<Answer, Handle*, Arguments...>() const noexcept
    {
        return &call<Answer, Handle, Arguments...>;
    }
};

template <auto function>
inline constexpr Slot<function> slot{};

// Fills the slots of services that the broker does not offer: they return
// CMPI_RC_ERR_NOT_SUPPORTED.
class NotOffered {
    template <typename Answer, typename... Arguments>
    static Answer call(Arguments... arguments)
    {
        return Detail::refuse<Answer>(Detail::statusOf(arguments...), CMPI_RC_ERR_NOT_SUPPORTED,
            "not offered by this broker");
    }
    template <typename Answer, typename... Arguments>
    static Answer callVariadic(Arguments... arguments, ...)
    {
        return call<Answer>(arguments...);
    }

public:
    template <typename Answer, typename... Arguments>
    constexpr operator Detail::Pointer<Answer, Arguments...>() const noexcept
    {
        return &call<Answer, Arguments...>;
    }
    template <typename Answer, typename... Arguments>
    constexpr operator Detail::VariadicPointer<Answer, Arguments...>() const noexcept
    {
        return &callVariadic<Answer, Arguments...>;
    }
};

inline constexpr NotOffered notOffered{};

// Returns the object behind a handle given as an argument. Throws Refusal
// (CMPI_RC_ERR_INVALID_HANDLE) when there is none.
template <typename Self>
Self& required(const typename Self::Handle* handle)
{
    if (Self* const object = Self::of(handle))
        return *object;
    throw Refusal(CMPI_RC_ERR_INVALID_HANDLE,
        std::string("no ") + Object::typeName(Self::kindOfSelf) + " behind the handle");
}

// Returns a text given as an argument. Throws Refusal (CMPI_RC_ERR_INVALID_PARAMETER) for null.
inline std::string_view requiredText(const char* text, const char* what)
{
    if (text == nullptr)
        throw Refusal(CMPI_RC_ERR_INVALID_PARAMETER, std::string(what) + " is null");
    return text;
}

} // namespace Host
