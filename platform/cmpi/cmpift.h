/* Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0 */

/* CMPI function tables. Every table begins with its version; a null slot means that the
   table's owner does not offer the operation. Objects are made through the broker and belong
   to it; only what `clone` returned must be given back with `release`. */

#ifndef CMPIFT_H
#define CMPIFT_H

#include "cmpidt.h"
#include "cmpios.h"

#ifdef __cplusplus
extern "C" {
#endif

/* What a provider is handed when it is loaded: one pointer for each group of services.
   Objects made through it belong to the object manager, unless they were cloned. */
struct _CMPIBroker {
    const void* hdl;
    const CMPIBrokerFT* bft;
    const CMPIBrokerEncFT* eft;
    const CMPIBrokerExtFT* xft;
    const CMPIBrokerMemFT* mft;
};

/* The broker: information about itself and up-calls into the object manager. */
struct _CMPIBrokerFT {
    unsigned int brokerCapabilities;
    CMPIVersion brokerVersion;
    const char* brokerName;
    CMPIContext* (*prepareAttachThread)(const CMPIBroker*, const CMPIContext*);
    CMPIStatus (*attachThread)(const CMPIBroker*, const CMPIContext*);
    CMPIStatus (*detachThread)(const CMPIBroker*, const CMPIContext*);
    CMPIStatus (*deliverIndication)(const CMPIBroker*, const CMPIContext*, const char*,
        const CMPIInstance*);
    CMPIEnumeration* (*enumerateInstanceNames)(const CMPIBroker*, const CMPIContext*,
        const CMPIObjectPath*, CMPIStatus*);
    CMPIInstance* (*getInstance)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
        const char**, CMPIStatus*);
    CMPIObjectPath* (*createInstance)(const CMPIBroker*, const CMPIContext*,
        const CMPIObjectPath*, const CMPIInstance*, CMPIStatus*);
    CMPIStatus (*modifyInstance)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
        const CMPIInstance*, const char**);
    CMPIStatus (*deleteInstance)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*);
    CMPIEnumeration* (*execQuery)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
        const char*, const char*, CMPIStatus*);
    CMPIEnumeration* (*enumerateInstances)(const CMPIBroker*, const CMPIContext*,
        const CMPIObjectPath*, const char**, CMPIStatus*);
    CMPIEnumeration* (*associators)(const CMPIBroker*, const CMPIContext*,
        const CMPIObjectPath*, const char*, const char*, const char*, const char*,
        const char**, CMPIStatus*);
    CMPIEnumeration* (*associatorNames)(const CMPIBroker*, const CMPIContext*,
        const CMPIObjectPath*, const char*, const char*, const char*, const char*, CMPIStatus*);
    CMPIEnumeration* (*references)(const CMPIBroker*, const CMPIContext*,
        const CMPIObjectPath*, const char*, const char*, const char**, CMPIStatus*);
    CMPIEnumeration* (*referenceNames)(const CMPIBroker*, const CMPIContext*,
        const CMPIObjectPath*, const char*, const char*, CMPIStatus*);
    CMPIData (*invokeMethod)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
        const char*, const CMPIArgs*, CMPIArgs*, CMPIStatus*);
    CMPIStatus (*setProperty)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
        const char*, const CMPIValue*, CMPIType);
    CMPIData (*getProperty)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
        const char*, CMPIStatus*);
};

/* The broker: making encapsulated objects, messages, logging and tracing. */
struct _CMPIBrokerEncFT {
    CMPIVersion ftVersion;
    CMPIInstance* (*newInstance)(const CMPIBroker*, const CMPIObjectPath*, CMPIStatus*);
    CMPIObjectPath* (*newObjectPath)(const CMPIBroker*, const char*, const char*, CMPIStatus*);
    CMPIArgs* (*newArgs)(const CMPIBroker*, CMPIStatus*);
    CMPIString* (*newString)(const CMPIBroker*, const char*, CMPIStatus*);
    CMPIArray* (*newArray)(const CMPIBroker*, CMPICount, CMPIType, CMPIStatus*);
    CMPIDateTime* (*newDateTime)(const CMPIBroker*, CMPIStatus*);
    CMPIDateTime* (*newDateTimeFromBinary)(const CMPIBroker*, CMPIUint64, CMPIBoolean,
        CMPIStatus*);
    CMPIDateTime* (*newDateTimeFromChars)(const CMPIBroker*, const char*, CMPIStatus*);
    CMPISelectExp* (*newSelectExp)(const CMPIBroker*, const char*, const char*, CMPIArray**,
        CMPIStatus*);
    CMPIBoolean (*classPathIsA)(const CMPIBroker*, const CMPIObjectPath*, const char*,
        CMPIStatus*);
    CMPIString* (*toString)(const CMPIBroker*, const void*, CMPIStatus*);
    CMPIBoolean (*isOfType)(const CMPIBroker*, const void*, const char*, CMPIStatus*);
    CMPIString* (*getType)(const CMPIBroker*, const void*, CMPIStatus*);
    CMPIString* (*getMessage)(const CMPIBroker*, const char*, const char*, CMPIStatus*,
        CMPICount, ...);
    CMPIStatus (*logMessage)(const CMPIBroker*, CMPISeverity, const char*, const char*,
        const CMPIString*);
    CMPIStatus (*trace)(const CMPIBroker*, CMPILevel, const char*, const char*,
        const CMPIString*);
    CMPIError* (*newCMPIError)(const CMPIBroker*, const char*, const char*, const char*,
        const CMPIErrorSeverity, const CMPIErrorProbableCause, const CMPIrc, CMPIStatus*);
    CMPIStatus (*openMessageFile)(const CMPIBroker*, const char*, CMPIMsgFileHandle*);
    CMPIStatus (*closeMessageFile)(const CMPIBroker*, const CMPIMsgFileHandle);
    CMPIString* (*getMessage2)(const CMPIBroker*, const char*, const CMPIMsgFileHandle,
        const char*, CMPIStatus*, CMPICount, ...);
};

/* The broker: files, threads, mutexes and conditions of the operating system. */
struct _CMPIBrokerExtFT {
    CMPIVersion ftVersion;
    char* (*resolveFileName)(const char*);
    void* (*newThread)(CMPIThreadFunc, void*, int);
    int (*joinThread)(void*, void**);
    int (*exitThread)(void*);
    int (*cancelThread)(void*);
    int (*threadSleep)(CMPIUint32);
    int (*threadOnce)(int*, CMPIThreadOnceFunc);
    int (*createThreadKey)(unsigned int*, CMPIThreadKeyCleanupFunc);
    int (*destroyThreadKey)(unsigned int);
    void* (*getThreadSpecific)(unsigned int);
    int (*setThreadSpecific)(unsigned int, void*);
    void* (*newMutex)(int);
    void (*destroyMutex)(void*);
    void (*lockMutex)(void*);
    void (*unlockMutex)(void*);
    void* (*newCondition)(int);
    void (*destroyCondition)(void*);
    int (*condWait)(void*, void*);
    int (*timedCondWait)(void*, void*, struct timespec*);
    int (*signalCondition)(void*);
};

/* The broker: memory owned by the object manager. May be absent (see CMPIBroker). */
struct _CMPIBrokerMemFT {
    CMPIVersion ftVersion;
    CMPIGcStat* (*mark)(const CMPIBroker*, CMPIStatus*);
    CMPIStatus (*release)(const CMPIBroker*, const CMPIGcStat*);
    void* (*cmpiMalloc)(const CMPIBroker*, size_t);
    void* (*cmpiCalloc)(const CMPIBroker*, size_t, size_t);
    void* (*cmpiRealloc)(const CMPIBroker*, void*, size_t);
    char* (*cmpiStrDup)(const CMPIBroker*, const char*);
    void (*cmpiFree)(const CMPIBroker*, void*);
    void (*freeInstance)(const CMPIBroker*, CMPIInstance*);
    void (*freeObjectPath)(const CMPIBroker*, CMPIObjectPath*);
    void (*freeArgs)(const CMPIBroker*, CMPIArgs*);
    void (*freeString)(const CMPIBroker*, CMPIString*);
    void (*freeArray)(const CMPIBroker*, CMPIArray*);
    void (*freeDateTime)(const CMPIBroker*, CMPIDateTime*);
    void (*freeSelectExp)(const CMPIBroker*, CMPISelectExp*);
};

/* Named values that accompany one request. */
struct _CMPIContext {
    const void* hdl;
    const CMPIContextFT* ft;
};

struct _CMPIContextFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPIContext*);
    CMPIContext* (*clone)(const CMPIContext*, CMPIStatus*);
    CMPIData (*getEntry)(const CMPIContext*, const char*, CMPIStatus*);
    CMPIData (*getEntryAt)(const CMPIContext*, CMPICount, CMPIString**, CMPIStatus*);
    CMPICount (*getEntryCount)(const CMPIContext*, CMPIStatus*);
    CMPIStatus (*addEntry)(const CMPIContext*, const char*, const CMPIValue*, const CMPIType);
};

/* Where a provider delivers its answer. */
struct _CMPIResult {
    const void* hdl;
    const CMPIResultFT* ft;
};

struct _CMPIResultFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPIResult*);
    CMPIResult* (*clone)(const CMPIResult*, CMPIStatus*);
    CMPIStatus (*returnData)(const CMPIResult*, const CMPIValue*, const CMPIType);
    CMPIStatus (*returnInstance)(const CMPIResult*, const CMPIInstance*);
    CMPIStatus (*returnObjectPath)(const CMPIResult*, const CMPIObjectPath*);
    CMPIStatus (*returnDone)(const CMPIResult*);
    CMPIStatus (*returnError)(const CMPIResult*, const CMPIError*);
};

/* A text, UTF-8, zero-terminated. */
struct _CMPIString {
    const void* hdl;
    const CMPIStringFT* ft;
};

struct _CMPIStringFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPIString*);
    CMPIString* (*clone)(const CMPIString*, CMPIStatus*);
    const char* (*getCharPtr)(const CMPIString*, CMPIStatus*);
};

/* A sequence of values of one simple type. */
struct _CMPIArray {
    const void* hdl;
    const CMPIArrayFT* ft;
};

struct _CMPIArrayFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPIArray*);
    CMPIArray* (*clone)(const CMPIArray*, CMPIStatus*);
    CMPICount (*getSize)(const CMPIArray*, CMPIStatus*);
    CMPIType (*getSimpleType)(const CMPIArray*, CMPIStatus*);
    CMPIData (*getElementAt)(const CMPIArray*, CMPICount, CMPIStatus*);
    CMPIStatus (*setElementAt)(const CMPIArray*, CMPICount, const CMPIValue*, CMPIType);
};

/* A forward cursor over values, such as the answer of an up-call. */
struct _CMPIEnumeration {
    const void* hdl;
    const CMPIEnumerationFT* ft;
};

struct _CMPIEnumerationFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPIEnumeration*);
    CMPIEnumeration* (*clone)(const CMPIEnumeration*, CMPIStatus*);
    CMPIData (*getNext)(const CMPIEnumeration*, CMPIStatus*);
    CMPIBoolean (*hasNext)(const CMPIEnumeration*, CMPIStatus*);
    CMPIArray* (*toArray)(const CMPIEnumeration*, CMPIStatus*);
};

/* An instance: an object path and named property values. */
struct _CMPIInstance {
    const void* hdl;
    const CMPIInstanceFT* ft;
};

struct _CMPIInstanceFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPIInstance*);
    CMPIInstance* (*clone)(const CMPIInstance*, CMPIStatus*);
    CMPIData (*getProperty)(const CMPIInstance*, const char*, CMPIStatus*);
    CMPIData (*getPropertyAt)(const CMPIInstance*, CMPICount, CMPIString**, CMPIStatus*);
    CMPICount (*getPropertyCount)(const CMPIInstance*, CMPIStatus*);
    CMPIStatus (*setProperty)(const CMPIInstance*, const char*, const CMPIValue*, CMPIType);
    CMPIObjectPath* (*getObjectPath)(const CMPIInstance*, CMPIStatus*);
    CMPIStatus (*setPropertyFilter)(const CMPIInstance*, const char**, const char**);
    CMPIStatus (*setObjectPath)(const CMPIInstance*, const CMPIObjectPath*);
    CMPIStatus (*setPropertyWithOrigin)(const CMPIInstance*, const char*, const CMPIValue*,
        const CMPIType, const char*);
};

/* The address of a class or instance: host, namespace, class name and keys. */
struct _CMPIObjectPath {
    const void* hdl;
    const CMPIObjectPathFT* ft;
};

struct _CMPIObjectPathFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPIObjectPath*);
    CMPIObjectPath* (*clone)(const CMPIObjectPath*, CMPIStatus*);
    CMPIStatus (*setNameSpace)(const CMPIObjectPath*, const char*);
    CMPIString* (*getNameSpace)(const CMPIObjectPath*, CMPIStatus*);
    CMPIStatus (*setHostname)(const CMPIObjectPath*, const char*);
    CMPIString* (*getHostname)(const CMPIObjectPath*, CMPIStatus*);
    CMPIStatus (*setClassName)(const CMPIObjectPath*, const char*);
    CMPIString* (*getClassName)(const CMPIObjectPath*, CMPIStatus*);
    CMPIStatus (*addKey)(const CMPIObjectPath*, const char*, const CMPIValue*, const CMPIType);
    CMPIData (*getKey)(const CMPIObjectPath*, const char*, CMPIStatus*);
    CMPIData (*getKeyAt)(const CMPIObjectPath*, CMPICount, CMPIString**, CMPIStatus*);
    CMPICount (*getKeyCount)(const CMPIObjectPath*, CMPIStatus*);
    CMPIStatus (*setNameSpaceFromObjectPath)(const CMPIObjectPath*, const CMPIObjectPath*);
    CMPIStatus (*setHostAndNameSpaceFromObjectPath)(const CMPIObjectPath*,
        const CMPIObjectPath*);
    CMPIData (*getClassQualifier)(const CMPIObjectPath*, const char*, CMPIStatus*);
    CMPIData (*getPropertyQualifier)(const CMPIObjectPath*, const char*, const char*,
        CMPIStatus*);
    CMPIData (*getMethodQualifier)(const CMPIObjectPath*, const char*, const char*,
        CMPIStatus*);
    CMPIData (*getParameterQualifier)(const CMPIObjectPath*, const char*, const char*,
        const char*, CMPIStatus*);
    CMPIString* (*toString)(const CMPIObjectPath*, CMPIStatus*);
};

/* Named arguments of a method call. */
struct _CMPIArgs {
    const void* hdl;
    const CMPIArgsFT* ft;
};

struct _CMPIArgsFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPIArgs*);
    CMPIArgs* (*clone)(const CMPIArgs*, CMPIStatus*);
    CMPIStatus (*addArg)(const CMPIArgs*, const char*, const CMPIValue*, const CMPIType);
    CMPIData (*getArg)(const CMPIArgs*, const char*, CMPIStatus*);
    CMPIData (*getArgAt)(const CMPIArgs*, CMPICount, CMPIString**, CMPIStatus*);
    CMPICount (*getArgCount)(const CMPIArgs*, CMPIStatus*);
};

/* A point in time or an interval, microseconds. */
struct _CMPIDateTime {
    const void* hdl;
    const CMPIDateTimeFT* ft;
};

struct _CMPIDateTimeFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPIDateTime*);
    CMPIDateTime* (*clone)(const CMPIDateTime*, CMPIStatus*);
    CMPIUint64 (*getBinaryFormat)(const CMPIDateTime*, CMPIStatus*);
    CMPIString* (*getStringFormat)(const CMPIDateTime*, CMPIStatus*);
    CMPIBoolean (*isInterval)(const CMPIDateTime*, CMPIStatus*);
};

/* A query expression. */
struct _CMPISelectExp {
    const void* hdl;
    const CMPISelectExpFT* ft;
};

struct _CMPISelectExpFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPISelectExp*);
    CMPISelectExp* (*clone)(const CMPISelectExp*, CMPIStatus*);
    CMPIBoolean (*evaluate)(const CMPISelectExp*, const CMPIInstance*, CMPIStatus*);
    CMPIString* (*getString)(const CMPISelectExp*, CMPIStatus*);
    CMPISelectCond* (*getDOC)(const CMPISelectExp*, CMPIStatus*);
    CMPISelectCond* (*getCOD)(const CMPISelectExp*, CMPIStatus*);
    CMPIBoolean (*evaluateUsingAccessor)(const CMPISelectExp*, CMPIAccessor*, void*,
        CMPIStatus*);
};

/* The condition of a query in disjunctive or conjunctive form. */
struct _CMPISelectCond {
    const void* hdl;
    const CMPISelectCondFT* ft;
};

struct _CMPISelectCondFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPISelectCond*);
    CMPISelectCond* (*clone)(const CMPISelectCond*, CMPIStatus*);
    CMPICount (*getCountAndType)(const CMPISelectCond*, int*, CMPIStatus*);
    CMPISubCond* (*getSubCondAt)(const CMPISelectCond*, CMPICount, CMPIStatus*);
};

/* One group of predicates of a condition. */
struct _CMPISubCond {
    const void* hdl;
    const CMPISubCondFT* ft;
};

struct _CMPISubCondFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPISubCond*);
    CMPISubCond* (*clone)(const CMPISubCond*, CMPIStatus*);
    CMPICount (*getCount)(const CMPISubCond*, CMPIStatus*);
    CMPIPredicate* (*getPredicateAt)(const CMPISubCond*, CMPICount, CMPIStatus*);
    CMPIPredicate* (*getPredicate)(const CMPISubCond*, const char*, CMPIStatus*);
};

/* One comparison of a condition. */
struct _CMPIPredicate {
    const void* hdl;
    const CMPIPredicateFT* ft;
};

struct _CMPIPredicateFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPIPredicate*);
    CMPIPredicate* (*clone)(const CMPIPredicate*, CMPIStatus*);
    CMPIStatus (*getData)(const CMPIPredicate*, CMPIType*, CMPIPredOp*, CMPIString**,
        CMPIString**);
    CMPIBoolean (*evaluateUsingAccessor)(const CMPIPredicate*, CMPIAccessor*, void*,
        CMPIStatus*);
};

/* A standard error with its severity, cause and source. */
struct _CMPIError {
    const void* hdl;
    const CMPIErrorFT* ft;
};

struct _CMPIErrorFT {
    CMPIVersion ftVersion;
    CMPIStatus (*release)(CMPIError*);
    CMPIError* (*clone)(const CMPIError*, CMPIStatus*);
    CMPIErrorType (*getErrorType)(const CMPIError*, CMPIStatus*);
    CMPIString* (*getOtherErrorType)(const CMPIError*, CMPIStatus*);
    CMPIString* (*getOwningEntity)(const CMPIError*, CMPIStatus*);
    CMPIString* (*getMessageID)(const CMPIError*, CMPIStatus*);
    CMPIString* (*getMessage)(const CMPIError*, CMPIStatus*);
    CMPIErrorSeverity (*getPerceivedSeverity)(const CMPIError*, CMPIStatus*);
    CMPIErrorProbableCause (*getProbableCause)(const CMPIError*, CMPIStatus*);
    CMPIString* (*getProbableCauseDescription)(const CMPIError*, CMPIStatus*);
    CMPIArray* (*getRecommendedActions)(const CMPIError*, CMPIStatus*);
    CMPIString* (*getErrorSource)(const CMPIError*, CMPIStatus*);
    CMPIErrorSrcFormat (*getErrorSourceFormat)(const CMPIError*, CMPIStatus*);
    CMPIString* (*getOtherErrorSourceFormat)(const CMPIError*, CMPIStatus*);
    CMPIrc (*getCIMStatusCode)(const CMPIError*, CMPIStatus*);
    CMPIString* (*getCIMStatusCodeDescription)(const CMPIError*, CMPIStatus*);
    CMPIArray* (*getMessageArguments)(const CMPIError*, CMPIStatus*);
    CMPIStatus (*setErrorType)(const CMPIError*, const CMPIErrorType);
    CMPIStatus (*setOtherErrorType)(const CMPIError*, const char*);
    CMPIStatus (*setProbableCauseDescription)(const CMPIError*, const char*);
    CMPIStatus (*setRecommendedActions)(const CMPIError*, const CMPIArray*);
    CMPIStatus (*setErrorSource)(const CMPIError*, const char*);
    CMPIStatus (*setErrorSourceFormat)(const CMPIError*, const CMPIErrorSrcFormat);
    CMPIStatus (*setOtherErrorSourceFormat)(const CMPIError*, const char*);
    CMPIStatus (*setCIMStatusCodeDescription)(const CMPIError*, const char*);
    CMPIStatus (*setMessageArguments)(const CMPIError*, const CMPIArray*);
};

/* Management interface of an instance provider. */
struct _CMPIInstanceMI {
    const void* hdl;
    const CMPIInstanceMIFT* ft;
};

struct _CMPIInstanceMIFT {
    CMPIVersion ftVersion;
    int miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean);
    CMPIStatus (*enumerateInstanceNames)(CMPIInstanceMI*, const CMPIContext*,
        const CMPIResult*, const CMPIObjectPath*);
    CMPIStatus (*enumerateInstances)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const char**);
    CMPIStatus (*getInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const char**);
    CMPIStatus (*createInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const CMPIInstance*);
    CMPIStatus (*modifyInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const CMPIInstance*, const char**);
    CMPIStatus (*deleteInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*);
    CMPIStatus (*execQuery)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const char*, const char*);
};

/* Management interface of an association provider. */
struct _CMPIAssociationMI {
    const void* hdl;
    const CMPIAssociationMIFT* ft;
};

struct _CMPIAssociationMIFT {
    CMPIVersion ftVersion;
    int miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIAssociationMI*, const CMPIContext*, CMPIBoolean);
    CMPIStatus (*associators)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const char*, const char*, const char*, const char*,
        const char**);
    CMPIStatus (*associatorNames)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const char*, const char*, const char*, const char*);
    CMPIStatus (*references)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const char*, const char*, const char**);
    CMPIStatus (*referenceNames)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const char*, const char*);
};

/* Management interface of a method provider. */
struct _CMPIMethodMI {
    const void* hdl;
    const CMPIMethodMIFT* ft;
};

struct _CMPIMethodMIFT {
    CMPIVersion ftVersion;
    int miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIMethodMI*, const CMPIContext*, CMPIBoolean);
    CMPIStatus (*invokeMethod)(CMPIMethodMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const char*, const CMPIArgs*, CMPIArgs*);
};

/* Management interface of a property provider. */
struct _CMPIPropertyMI {
    const void* hdl;
    const CMPIPropertyMIFT* ft;
};

struct _CMPIPropertyMIFT {
    CMPIVersion ftVersion;
    int miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIPropertyMI*, const CMPIContext*, CMPIBoolean);
    CMPIStatus (*setProperty)(CMPIPropertyMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const char*, const CMPIData);
    CMPIStatus (*getProperty)(CMPIPropertyMI*, const CMPIContext*, const CMPIResult*,
        const CMPIObjectPath*, const char*);
    CMPIStatus (*setPropertyWithOrigin)(CMPIPropertyMI*, const CMPIContext*, const CMPIResult*,
        CMPIObjectPath*, const char*, const CMPIData, const char*);
};

/* Management interface of an indication provider. */
struct _CMPIIndicationMI {
    const void* hdl;
    const CMPIIndicationMIFT* ft;
};

struct _CMPIIndicationMIFT {
    CMPIVersion ftVersion;
    int miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIIndicationMI*, const CMPIContext*, CMPIBoolean);
    CMPIStatus (*authorizeFilter)(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp*,
        const char*, const CMPIObjectPath*, const char*);
    CMPIStatus (*mustPoll)(CMPIIndicationMI*, const CMPIContext*, const CMPIResult*,
        const CMPISelectExp*, const char*, const CMPIObjectPath*);
    CMPIStatus (*activateFilter)(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp*,
        const char*, const CMPIObjectPath*, CMPIBoolean);
    CMPIStatus (*deActivateFilter)(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp*,
        const char*, const CMPIObjectPath*, CMPIBoolean);
    CMPIStatus (*enableIndications)(CMPIIndicationMI*, const CMPIContext*);
    CMPIStatus (*disableIndications)(CMPIIndicationMI*, const CMPIContext*);
    CMPIStatus (*authorizeFilterCollection)(CMPIIndicationMI*, const CMPIContext*,
        const CMPIInstance*);
    CMPIStatus (*activateFilterCollection)(CMPIIndicationMI*, const CMPIContext*,
        const CMPIInstance*, CMPIBoolean);
    CMPIStatus (*deActivateFilterCollection)(CMPIIndicationMI*, const CMPIContext*,
        const CMPIInstance*, CMPIBoolean);
};

#ifdef __cplusplus
}
#endif

#endif
