// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Error.h"

#include "host/broker/Array.h"
#include "host/broker/Slot.h"
#include "host/broker/String.h"

namespace Host {

namespace {

const String* textOrNull(Arena& arena, const char* text)
{
    return text == nullptr ? nullptr : &String::make(arena, text);
}

template <typename Part>
void move(const Part*& part, Arena& arena)
{
    if (part != nullptr)
        part = &part->copiedTo(arena);
}

} // namespace

Error& Error::make(Arena& arena, const char* owningEntity, const char* messageId,
    const char* message, CMPIErrorSeverity severity, CMPIErrorProbableCause probableCause,
    CMPIrc statusCode)
{
    Fields fields;
    fields.owningEntity = textOrNull(arena, owningEntity);
    fields.messageId = textOrNull(arena, messageId);
    fields.message = textOrNull(arena, message);
    fields.severity = severity;
    fields.probableCause = probableCause;
    fields.statusCode = statusCode;
    return arena.make<Error>(arena, fields);
}

Error& Error::copiedTo(Arena& arena) const
{
    Fields fields = fields_;
    for (const auto text : {&Fields::owningEntity, &Fields::messageId, &Fields::message,
             &Fields::otherType, &Fields::probableCauseDescription, &Fields::source,
             &Fields::otherSourceFormat, &Fields::statusCodeDescription})
        move(fields.*text, arena);
    move(fields.recommendedActions, arena);
    move(fields.messageArguments, arena);
    return arena.make<Error>(arena, fields);
}

template <auto member>
auto Error::get(const Error& error)
{
    return error.fields_.*member;
}

template <auto member>
CMPIString* Error::getText(const Error& error)
{
    const String* const text = error.fields_.*member;
    return text == nullptr ? nullptr : text->handle();
}

template <auto member>
CMPIArray* Error::getArray(const Error& error)
{
    const Array* const array = error.fields_.*member;
    return array == nullptr ? nullptr : array->copiedTo(Arena::required()).handle();
}

template <auto member, typename Number>
void Error::set(Error& error, Number number)
{
    error.fields_.*member = number;
}

template <auto member>
void Error::setText(Error& error, const char* text)
{
    error.fields_.*member = textOrNull(error.memory(), text);
}

template <auto member>
void Error::setArray(Error& error, const CMPIArray* array)
{
    error.fields_.*member =
        array == nullptr ? nullptr : &required<Array>(array).copiedTo(error.memory());
}

const CMPIErrorFT Error::functions = {
    .ftVersion = CMPIVersion200,
    .release = slot<&Error::release>,
    .clone = slot<&Error::cloned>,
    .getErrorType = slot<&Error::get<&Fields::type>>,
    .getOtherErrorType = slot<&Error::getText<&Fields::otherType>>,
    .getOwningEntity = slot<&Error::getText<&Fields::owningEntity>>,
    .getMessageID = slot<&Error::getText<&Fields::messageId>>,
    .getMessage = slot<&Error::getText<&Fields::message>>,
    .getPerceivedSeverity = slot<&Error::get<&Fields::severity>>,
    .getProbableCause = slot<&Error::get<&Fields::probableCause>>,
    .getProbableCauseDescription = slot<&Error::getText<&Fields::probableCauseDescription>>,
    .getRecommendedActions = slot<&Error::getArray<&Fields::recommendedActions>>,
    .getErrorSource = slot<&Error::getText<&Fields::source>>,
    .getErrorSourceFormat = slot<&Error::get<&Fields::sourceFormat>>,
    .getOtherErrorSourceFormat = slot<&Error::getText<&Fields::otherSourceFormat>>,
    .getCIMStatusCode = slot<&Error::get<&Fields::statusCode>>,
    .getCIMStatusCodeDescription = slot<&Error::getText<&Fields::statusCodeDescription>>,
    .getMessageArguments = slot<&Error::getArray<&Fields::messageArguments>>,
    .setErrorType = slot<&Error::set<&Fields::type, CMPIErrorType>>,
    .setOtherErrorType = slot<&Error::setText<&Fields::otherType>>,
    .setProbableCauseDescription = slot<&Error::setText<&Fields::probableCauseDescription>>,
    .setRecommendedActions = slot<&Error::setArray<&Fields::recommendedActions>>,
    .setErrorSource = slot<&Error::setText<&Fields::source>>,
    .setErrorSourceFormat = slot<&Error::set<&Fields::sourceFormat, CMPIErrorSrcFormat>>,
    .setOtherErrorSourceFormat = slot<&Error::setText<&Fields::otherSourceFormat>>,
    .setCIMStatusCodeDescription = slot<&Error::setText<&Fields::statusCodeDescription>>,
    .setMessageArguments = slot<&Error::setArray<&Fields::messageArguments>>,
};

} // namespace Host
