/* Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0 */

/* CMPI convenience functions: one call for each slot of the function tables in cmpift.h, and
   the factory and stub macros from which a provider's function tables are made. Each function
   hands its arguments on unchanged and requires an object whose table has the slot. Values
   are passed by address, texts of type CMPI_chars as the pointer to their characters. */

#ifndef CMPIMACS_H
#define CMPIMACS_H

#include "cmpidt.h"
#include "cmpift.h"

#define CMPI_INLINE static inline

/* ---- Status ---- */

CMPI_INLINE void CMSetStatus(CMPIStatus* status, CMPIrc code)
{
    if (status) {
        status->rc = code;
        status->msg = NULL;
    }
}

CMPI_INLINE void CMSetStatusWithString(CMPIStatus* status, CMPIrc code, CMPIString* message)
{
    if (status) {
        status->rc = code;
        status->msg = message;
    }
}

CMPI_INLINE void CMSetStatusWithChars(const CMPIBroker* broker, CMPIStatus* status, CMPIrc code,
        const char* message)
{
    if (status) {
        status->rc = code;
        status->msg = broker ? broker->eft->newString(broker, message, NULL) : NULL;
    }
}

#define CMReturn(code)                        \
    do {                                      \
        CMPIStatus cmpi_status = {code, NULL}; \
        return cmpi_status;                   \
    } while (0)

#define CMReturnWithString(code, message)        \
    do {                                         \
        CMPIStatus cmpi_status = {code, message}; \
        return cmpi_status;                      \
    } while (0)

#define CMReturnWithChars(broker, code, message)                        \
    do {                                                                \
        CMPIStatus cmpi_status;                                         \
        CMSetStatusWithChars((broker), &cmpi_status, (code), (message)); \
        return cmpi_status;                                             \
    } while (0)

/* ---- Any encapsulated object ---- */

#define CMIsNullObject(object) ((object) == NULL || (object)->hdl == NULL)
#define CMIsNullValue(data) (((data).state & CMPI_nullValue) != 0)
#define CMRelease(object) ((object)->ft->release((object)))
#define CMClone(object, rc) ((object)->ft->clone((object), (rc)))

/* ---- Broker: making objects ---- */

CMPI_INLINE CMPIInstance* CMNewInstance(const CMPIBroker* broker, const CMPIObjectPath* path,
        CMPIStatus* rc)
{
    return broker->eft->newInstance(broker, path, rc);
}

CMPI_INLINE CMPIObjectPath* CMNewObjectPath(const CMPIBroker* broker, const char* nameSpace,
        const char* className, CMPIStatus* rc)
{
    return broker->eft->newObjectPath(broker, nameSpace, className, rc);
}

CMPI_INLINE CMPIArgs* CMNewArgs(const CMPIBroker* broker, CMPIStatus* rc)
{
    return broker->eft->newArgs(broker, rc);
}

CMPI_INLINE CMPIString* CMNewString(const CMPIBroker* broker, const char* text, CMPIStatus* rc)
{
    return broker->eft->newString(broker, text, rc);
}

CMPI_INLINE CMPIArray* CMNewArray(const CMPIBroker* broker, CMPICount size, CMPIType type,
        CMPIStatus* rc)
{
    return broker->eft->newArray(broker, size, type, rc);
}

CMPI_INLINE CMPIDateTime* CMNewDateTime(const CMPIBroker* broker, CMPIStatus* rc)
{
    return broker->eft->newDateTime(broker, rc);
}

CMPI_INLINE CMPIDateTime* CMNewDateTimeFromBinary(const CMPIBroker* broker,
        CMPIUint64 microseconds, CMPIBoolean isInterval, CMPIStatus* rc)
{
    return broker->eft->newDateTimeFromBinary(broker, microseconds, isInterval, rc);
}

CMPI_INLINE CMPIDateTime* CMNewDateTimeFromChars(const CMPIBroker* broker, const char* text,
        CMPIStatus* rc)
{
    return broker->eft->newDateTimeFromChars(broker, text, rc);
}

CMPI_INLINE CMPISelectExp* CMNewSelectExp(const CMPIBroker* broker, const char* query,
        const char* language, CMPIArray** projection, CMPIStatus* rc)
{
    return broker->eft->newSelectExp(broker, query, language, projection, rc);
}

CMPI_INLINE CMPIError* CMNewCMPIError(const CMPIBroker* broker, const char* owner,
        const char* messageId, const char* message, CMPIErrorSeverity severity,
        CMPIErrorProbableCause cause, CMPIrc code, CMPIStatus* rc)
{
    return broker->eft->newCMPIError(broker, owner, messageId, message, severity, cause,
        code, rc);
}

CMPI_INLINE CMPIBoolean CMClassPathIsA(const CMPIBroker* broker, const CMPIObjectPath* path,
        const char* className, CMPIStatus* rc)
{
    return broker->eft->classPathIsA(broker, path, className, rc);
}

CMPI_INLINE CMPIString* CDToString(const CMPIBroker* broker, const void* object, CMPIStatus* rc)
{
    return broker->eft->toString(broker, object, rc);
}

CMPI_INLINE CMPIBoolean CDIsOfType(const CMPIBroker* broker, const void* object,
        const char* type, CMPIStatus* rc)
{
    return broker->eft->isOfType(broker, object, type, rc);
}

CMPI_INLINE CMPIString* CDGetType(const CMPIBroker* broker, const void* object, CMPIStatus* rc)
{
    return broker->eft->getType(broker, object, rc);
}

/* ---- Broker: messages, logging, tracing ---- */

#define CMGetMessage(broker, id, text, rc, ...) \
    ((broker)->eft->getMessage((broker), (id), (text), (rc), __VA_ARGS__))
#define CMGetMessage2(broker, id, file, text, rc, ...) \
    ((broker)->eft->getMessage2((broker), (id), (file), (text), (rc), __VA_ARGS__))

CMPI_INLINE CMPIStatus CMOpenMessageFile(const CMPIBroker* broker, const char* name,
        CMPIMsgFileHandle* file)
{
    return broker->eft->openMessageFile(broker, name, file);
}

CMPI_INLINE CMPIStatus CMCloseMessageFile(const CMPIBroker* broker,
        const CMPIMsgFileHandle file)
{
    return broker->eft->closeMessageFile(broker, file);
}

CMPI_INLINE CMPIStatus CMLogMessage(const CMPIBroker* broker, CMPISeverity severity,
        const char* id, const char* text, const CMPIString* string)
{
    return broker->eft->logMessage(broker, severity, id, text, string);
}

CMPI_INLINE CMPIStatus CMTraceMessage(const CMPIBroker* broker, CMPILevel level,
        const char* component, const char* text, const CMPIString* string)
{
    return broker->eft->trace(broker, level, component, text, string);
}

/* ---- Broker: up-calls into the object manager ---- */

CMPI_INLINE CMPIContext* CBPrepareAttachThread(const CMPIBroker* broker,
        const CMPIContext* context)
{
    return broker->bft->prepareAttachThread(broker, context);
}

CMPI_INLINE CMPIStatus CBAttachThread(const CMPIBroker* broker, const CMPIContext* context)
{
    return broker->bft->attachThread(broker, context);
}

CMPI_INLINE CMPIStatus CBDetachThread(const CMPIBroker* broker, const CMPIContext* context)
{
    return broker->bft->detachThread(broker, context);
}

CMPI_INLINE CMPIStatus CBDeliverIndication(const CMPIBroker* broker, const CMPIContext* context,
        const char* nameSpace, const CMPIInstance* indication)
{
    return broker->bft->deliverIndication(broker, context, nameSpace, indication);
}

CMPI_INLINE CMPIEnumeration* CBEnumInstanceNames(const CMPIBroker* broker,
        const CMPIContext* context, const CMPIObjectPath* path, CMPIStatus* rc)
{
    return broker->bft->enumerateInstanceNames(broker, context, path, rc);
}

CMPI_INLINE CMPIEnumeration* CBEnumInstances(const CMPIBroker* broker,
        const CMPIContext* context, const CMPIObjectPath* path, const char** properties,
        CMPIStatus* rc)
{
    return broker->bft->enumerateInstances(broker, context, path, properties, rc);
}

CMPI_INLINE CMPIInstance* CBGetInstance(const CMPIBroker* broker, const CMPIContext* context,
        const CMPIObjectPath* path, const char** properties, CMPIStatus* rc)
{
    return broker->bft->getInstance(broker, context, path, properties, rc);
}

CMPI_INLINE CMPIObjectPath* CBCreateInstance(const CMPIBroker* broker,
        const CMPIContext* context, const CMPIObjectPath* path, const CMPIInstance* instance,
        CMPIStatus* rc)
{
    return broker->bft->createInstance(broker, context, path, instance, rc);
}

CMPI_INLINE CMPIStatus CBModifyInstance(const CMPIBroker* broker, const CMPIContext* context,
        const CMPIObjectPath* path, const CMPIInstance* instance, const char** properties)
{
    return broker->bft->modifyInstance(broker, context, path, instance, properties);
}

CMPI_INLINE CMPIStatus CBDeleteInstance(const CMPIBroker* broker, const CMPIContext* context,
        const CMPIObjectPath* path)
{
    return broker->bft->deleteInstance(broker, context, path);
}

CMPI_INLINE CMPIEnumeration* CBExecQuery(const CMPIBroker* broker, const CMPIContext* context,
        const CMPIObjectPath* path, const char* query, const char* language, CMPIStatus* rc)
{
    return broker->bft->execQuery(broker, context, path, query, language, rc);
}

CMPI_INLINE CMPIEnumeration* CBAssociators(const CMPIBroker* broker, const CMPIContext* context,
        const CMPIObjectPath* path, const char* assocClass, const char* resultClass,
        const char* role, const char* resultRole, const char** properties, CMPIStatus* rc)
{
    return broker->bft->associators(broker, context, path, assocClass, resultClass, role,
        resultRole, properties, rc);
}

CMPI_INLINE CMPIEnumeration* CBAssociatorNames(const CMPIBroker* broker,
        const CMPIContext* context, const CMPIObjectPath* path, const char* assocClass,
        const char* resultClass, const char* role, const char* resultRole, CMPIStatus* rc)
{
    return broker->bft->associatorNames(broker, context, path, assocClass, resultClass, role,
        resultRole, rc);
}

CMPI_INLINE CMPIEnumeration* CBReferences(const CMPIBroker* broker, const CMPIContext* context,
        const CMPIObjectPath* path, const char* resultClass, const char* role,
        const char** properties, CMPIStatus* rc)
{
    return broker->bft->references(broker, context, path, resultClass, role, properties, rc);
}

CMPI_INLINE CMPIEnumeration* CBReferenceNames(const CMPIBroker* broker,
        const CMPIContext* context, const CMPIObjectPath* path, const char* resultClass,
        const char* role, CMPIStatus* rc)
{
    return broker->bft->referenceNames(broker, context, path, resultClass, role, rc);
}

CMPI_INLINE CMPIData CBInvokeMethod(const CMPIBroker* broker, const CMPIContext* context,
        const CMPIObjectPath* path, const char* method, const CMPIArgs* in, CMPIArgs* out,
        CMPIStatus* rc)
{
    return broker->bft->invokeMethod(broker, context, path, method, in, out, rc);
}

CMPI_INLINE CMPIData CBGetProperty(const CMPIBroker* broker, const CMPIContext* context,
        const CMPIObjectPath* path, const char* name, CMPIStatus* rc)
{
    return broker->bft->getProperty(broker, context, path, name, rc);
}

CMPI_INLINE CMPIStatus CBSetProperty(const CMPIBroker* broker, const CMPIContext* context,
        const CMPIObjectPath* path, const char* name, const void* value, CMPIType type)
{
    return broker->bft->setProperty(broker, context, path, name, (const CMPIValue*)value, type);
}

/* ---- Result ---- */

CMPI_INLINE CMPIStatus CMReturnData(const CMPIResult* result, const void* value, CMPIType type)
{
    return result->ft->returnData(result, (const CMPIValue*)value, type);
}

CMPI_INLINE CMPIStatus CMReturnInstance(const CMPIResult* result, const CMPIInstance* instance)
{
    return result->ft->returnInstance(result, instance);
}

CMPI_INLINE CMPIStatus CMReturnObjectPath(const CMPIResult* result, const CMPIObjectPath* path)
{
    return result->ft->returnObjectPath(result, path);
}

CMPI_INLINE CMPIStatus CMReturnDone(const CMPIResult* result)
{
    return result->ft->returnDone(result);
}

CMPI_INLINE CMPIStatus CMReturnError(const CMPIResult* result, const CMPIError* error)
{
    return result->ft->returnError(result, error);
}

/* ---- String ---- */

CMPI_INLINE const char* CMGetCharsPtr(const CMPIString* string, CMPIStatus* rc)
{
    return string->ft->getCharPtr(string, rc);
}

#define CMGetCharPtr(string) CMGetCharsPtr((string), NULL)

/* ---- Array ---- */

CMPI_INLINE CMPICount CMGetArrayCount(const CMPIArray* array, CMPIStatus* rc)
{
    return array->ft->getSize(array, rc);
}

CMPI_INLINE CMPIType CMGetArrayType(const CMPIArray* array, CMPIStatus* rc)
{
    return array->ft->getSimpleType(array, rc);
}

CMPI_INLINE CMPIData CMGetArrayElementAt(const CMPIArray* array, CMPICount index,
        CMPIStatus* rc)
{
    return array->ft->getElementAt(array, index, rc);
}

CMPI_INLINE CMPIStatus CMSetArrayElementAt(const CMPIArray* array, CMPICount index,
        const void* value, CMPIType type)
{
    return array->ft->setElementAt(array, index, (const CMPIValue*)value, type);
}

/* ---- Enumeration ---- */

CMPI_INLINE CMPIData CMGetNext(const CMPIEnumeration* enumeration, CMPIStatus* rc)
{
    return enumeration->ft->getNext(enumeration, rc);
}

CMPI_INLINE CMPIBoolean CMHasNext(const CMPIEnumeration* enumeration, CMPIStatus* rc)
{
    return enumeration->ft->hasNext(enumeration, rc);
}

CMPI_INLINE CMPIArray* CMToArray(const CMPIEnumeration* enumeration, CMPIStatus* rc)
{
    return enumeration->ft->toArray(enumeration, rc);
}

/* ---- Instance ---- */

CMPI_INLINE CMPIData CMGetProperty(const CMPIInstance* instance, const char* name,
        CMPIStatus* rc)
{
    return instance->ft->getProperty(instance, name, rc);
}

CMPI_INLINE CMPIData CMGetPropertyAt(const CMPIInstance* instance, CMPICount index,
        CMPIString** name, CMPIStatus* rc)
{
    return instance->ft->getPropertyAt(instance, index, name, rc);
}

CMPI_INLINE CMPICount CMGetPropertyCount(const CMPIInstance* instance, CMPIStatus* rc)
{
    return instance->ft->getPropertyCount(instance, rc);
}

CMPI_INLINE CMPIStatus CMSetProperty(const CMPIInstance* instance, const char* name,
        const void* value, CMPIType type)
{
    return instance->ft->setProperty(instance, name, (const CMPIValue*)value, type);
}

CMPI_INLINE CMPIStatus CMSetPropertyWithOrigin(const CMPIInstance* instance, const char* name,
        const void* value, CMPIType type, const char* origin)
{
    return instance->ft->setPropertyWithOrigin(instance, name, (const CMPIValue*)value, type,
        origin);
}

CMPI_INLINE CMPIStatus CMSetPropertyFilter(const CMPIInstance* instance,
        const char** properties, const char** keys)
{
    return instance->ft->setPropertyFilter(instance, properties, keys);
}

CMPI_INLINE CMPIObjectPath* CMGetObjectPath(const CMPIInstance* instance, CMPIStatus* rc)
{
    return instance->ft->getObjectPath(instance, rc);
}

CMPI_INLINE CMPIStatus CMSetObjectPath(const CMPIInstance* instance, const CMPIObjectPath* path)
{
    return instance->ft->setObjectPath(instance, path);
}

/* ---- Object path ---- */

CMPI_INLINE CMPIStatus CMSetNameSpace(const CMPIObjectPath* path, const char* nameSpace)
{
    return path->ft->setNameSpace(path, nameSpace);
}

CMPI_INLINE CMPIString* CMGetNameSpace(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return path->ft->getNameSpace(path, rc);
}

CMPI_INLINE CMPIStatus CMSetHostname(const CMPIObjectPath* path, const char* hostname)
{
    return path->ft->setHostname(path, hostname);
}

CMPI_INLINE CMPIString* CMGetHostname(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return path->ft->getHostname(path, rc);
}

CMPI_INLINE CMPIStatus CMSetClassName(const CMPIObjectPath* path, const char* className)
{
    return path->ft->setClassName(path, className);
}

CMPI_INLINE CMPIString* CMGetClassName(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return path->ft->getClassName(path, rc);
}

CMPI_INLINE CMPIStatus CMAddKey(const CMPIObjectPath* path, const char* name, const void* value,
        CMPIType type)
{
    return path->ft->addKey(path, name, (const CMPIValue*)value, type);
}

CMPI_INLINE CMPIData CMGetKey(const CMPIObjectPath* path, const char* name, CMPIStatus* rc)
{
    return path->ft->getKey(path, name, rc);
}

CMPI_INLINE CMPIData CMGetKeyAt(const CMPIObjectPath* path, CMPICount index, CMPIString** name,
        CMPIStatus* rc)
{
    return path->ft->getKeyAt(path, index, name, rc);
}

CMPI_INLINE CMPICount CMGetKeyCount(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return path->ft->getKeyCount(path, rc);
}

CMPI_INLINE CMPIStatus CMSetNameSpaceFromObjectPath(const CMPIObjectPath* path,
        const CMPIObjectPath* source)
{
    return path->ft->setNameSpaceFromObjectPath(path, source);
}

CMPI_INLINE CMPIStatus CMSetHostAndNameSpaceFromObjectPath(const CMPIObjectPath* path,
        const CMPIObjectPath* source)
{
    return path->ft->setHostAndNameSpaceFromObjectPath(path, source);
}

CMPI_INLINE CMPIData CMGetClassQualifier(const CMPIObjectPath* path, const char* qualifier,
        CMPIStatus* rc)
{
    return path->ft->getClassQualifier(path, qualifier, rc);
}

CMPI_INLINE CMPIData CMGetPropertyQualifier(const CMPIObjectPath* path, const char* property,
        const char* qualifier, CMPIStatus* rc)
{
    return path->ft->getPropertyQualifier(path, property, qualifier, rc);
}

CMPI_INLINE CMPIData CMGetMethodQualifier(const CMPIObjectPath* path, const char* method,
        const char* qualifier, CMPIStatus* rc)
{
    return path->ft->getMethodQualifier(path, method, qualifier, rc);
}

CMPI_INLINE CMPIData CMGetParameterQualifier(const CMPIObjectPath* path, const char* method,
        const char* parameter, const char* qualifier, CMPIStatus* rc)
{
    return path->ft->getParameterQualifier(path, method, parameter, qualifier, rc);
}

CMPI_INLINE CMPIString* CMObjectPathToString(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return path->ft->toString(path, rc);
}

/* ---- Arguments ---- */

CMPI_INLINE CMPIStatus CMAddArg(const CMPIArgs* args, const char* name, const void* value,
        CMPIType type)
{
    return args->ft->addArg(args, name, (const CMPIValue*)value, type);
}

CMPI_INLINE CMPIData CMGetArg(const CMPIArgs* args, const char* name, CMPIStatus* rc)
{
    return args->ft->getArg(args, name, rc);
}

CMPI_INLINE CMPIData CMGetArgAt(const CMPIArgs* args, CMPICount index, CMPIString** name,
        CMPIStatus* rc)
{
    return args->ft->getArgAt(args, index, name, rc);
}

CMPI_INLINE CMPICount CMGetArgCount(const CMPIArgs* args, CMPIStatus* rc)
{
    return args->ft->getArgCount(args, rc);
}

/* ---- Date and time ---- */

CMPI_INLINE CMPIUint64 CMGetBinaryFormat(const CMPIDateTime* dateTime, CMPIStatus* rc)
{
    return dateTime->ft->getBinaryFormat(dateTime, rc);
}

CMPI_INLINE CMPIString* CMGetStringFormat(const CMPIDateTime* dateTime, CMPIStatus* rc)
{
    return dateTime->ft->getStringFormat(dateTime, rc);
}

CMPI_INLINE CMPIBoolean CMIsInterval(const CMPIDateTime* dateTime, CMPIStatus* rc)
{
    return dateTime->ft->isInterval(dateTime, rc);
}

/* ---- Context ---- */

CMPI_INLINE CMPIData CMGetContextEntry(const CMPIContext* context, const char* name,
        CMPIStatus* rc)
{
    return context->ft->getEntry(context, name, rc);
}

CMPI_INLINE CMPIData CMGetContextEntryAt(const CMPIContext* context, CMPICount index,
        CMPIString** name, CMPIStatus* rc)
{
    return context->ft->getEntryAt(context, index, name, rc);
}

CMPI_INLINE CMPICount CMGetContextEntryCount(const CMPIContext* context, CMPIStatus* rc)
{
    return context->ft->getEntryCount(context, rc);
}

CMPI_INLINE CMPIStatus CMAddContextEntry(const CMPIContext* context, const char* name,
        const void* value, CMPIType type)
{
    return context->ft->addEntry(context, name, (const CMPIValue*)value, type);
}

/* ---- Queries ---- */

CMPI_INLINE CMPIBoolean CMEvaluateSelExp(const CMPISelectExp* expression,
        const CMPIInstance* instance, CMPIStatus* rc)
{
    return expression->ft->evaluate(expression, instance, rc);
}

CMPI_INLINE CMPIString* CMGetSelExpString(const CMPISelectExp* expression, CMPIStatus* rc)
{
    return expression->ft->getString(expression, rc);
}

CMPI_INLINE CMPISelectCond* CMGetDoc(const CMPISelectExp* expression, CMPIStatus* rc)
{
    return expression->ft->getDOC(expression, rc);
}

CMPI_INLINE CMPISelectCond* CMGetCod(const CMPISelectExp* expression, CMPIStatus* rc)
{
    return expression->ft->getCOD(expression, rc);
}

CMPI_INLINE CMPIBoolean CMEvaluateSelExpUsingAccessor(const CMPISelectExp* expression,
        CMPIAccessor* accessor, void* parameter, CMPIStatus* rc)
{
    return expression->ft->evaluateUsingAccessor(expression, accessor, parameter, rc);
}

CMPI_INLINE CMPICount CMGetSubCondCountAndType(const CMPISelectCond* condition, int* type,
        CMPIStatus* rc)
{
    return condition->ft->getCountAndType(condition, type, rc);
}

CMPI_INLINE CMPISubCond* CMGetSubCondAt(const CMPISelectCond* condition, CMPICount index,
        CMPIStatus* rc)
{
    return condition->ft->getSubCondAt(condition, index, rc);
}

CMPI_INLINE CMPICount CMGetPredicateCount(const CMPISubCond* condition, CMPIStatus* rc)
{
    return condition->ft->getCount(condition, rc);
}

CMPI_INLINE CMPIPredicate* CMGetPredicateAt(const CMPISubCond* condition, CMPICount index,
        CMPIStatus* rc)
{
    return condition->ft->getPredicateAt(condition, index, rc);
}

CMPI_INLINE CMPIPredicate* CMGetPredicate(const CMPISubCond* condition, const char* name,
        CMPIStatus* rc)
{
    return condition->ft->getPredicate(condition, name, rc);
}

CMPI_INLINE CMPIStatus CMGetPredicateData(const CMPIPredicate* predicate, CMPIType* type,
        CMPIPredOp* operation, CMPIString** left, CMPIString** right)
{
    return predicate->ft->getData(predicate, type, operation, left, right);
}

CMPI_INLINE CMPIBoolean CMEvaluatePredicateUsingAccessor(const CMPIPredicate* predicate,
        CMPIAccessor* accessor, void* parameter, CMPIStatus* rc)
{
    return predicate->ft->evaluateUsingAccessor(predicate, accessor, parameter, rc);
}

#endif
