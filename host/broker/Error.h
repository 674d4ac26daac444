// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A standard error that a provider delivers, behind a CMPIError: who, what, how bad and why.

#pragma once

#include "host/broker/Object.h"

#include <string_view>

namespace Host {

class Array;

class Error : public Encapsulated<Error, CMPIError, Object::Kind::error> {
public:
    // The numbers are those of CIM_Error's value maps. A text or array that was not given is
    // null.
    struct Fields {
        const String* owningEntity = nullptr;
        const String* messageId = nullptr;
        const String* message = nullptr;
        CMPIErrorSeverity severity = ErrorSevUnknown;
        CMPIErrorProbableCause probableCause = ErrorProbCauseUnknown;
        CMPIrc statusCode = CMPI_RC_OK;
        // What follows is set later or never.
        CMPIErrorType type = UnknownErrorType;
        CMPIErrorSrcFormat sourceFormat = CMPIErrSrcUnknown;
        const String* otherType = nullptr;
        const String* probableCauseDescription = nullptr;
        const String* source = nullptr;
        const String* otherSourceFormat = nullptr;
        const String* statusCodeDescription = nullptr;
        const Array* recommendedActions = nullptr;
        const Array* messageArguments = nullptr;
    };

    // The texts may be null.
    static Error& make(Arena& arena, const char* owningEntity, const char* messageId,
        const char* message, CMPIErrorSeverity severity, CMPIErrorProbableCause probableCause,
        CMPIrc statusCode);

    const Fields& fields() const noexcept { return fields_; }

    Error& copiedTo(Arena& arena) const;

    static const CMPIErrorFT functions;

private:
    friend class Arena;
    Error(Arena& home, const Fields& fields) : Encapsulated(&home), fields_(fields) {}

    // One slot function for each member of Fields that a provider reads or sets.
    template <auto member>
    static auto get(const Error& error);
    template <auto member>
    static CMPIString* getText(const Error& error);
    template <auto member>
    static CMPIArray* getArray(const Error& error);
    template <auto member, typename Number>
    static void set(Error& error, Number number);
    template <auto member>
    static void setText(Error& error, const char* text);
    template <auto member>
    static void setArray(Error& error, const CMPIArray* array);

    Fields fields_;
};

} // namespace Host
