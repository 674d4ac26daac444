/* Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0 */

/* CMPI data types and constants, version 2.0 of the Common Manageability Programming
   Interface (The Open Group, technical standard C061). Layouts are those of x86-64 Linux and
   are part of a binary interface: nothing here may be reordered. */

#ifndef CMPIDT_H
#define CMPIDT_H

#include "cmpipl.h"

#include <stddef.h>
#include <stdint.h>

#ifdef __cplusplus
extern "C" {
#endif

#define CMPIVersion100 100
#define CMPIVersion200 200

/* The version this set of headers describes. */
#ifndef CMPI_VERSION
#define CMPI_VERSION CMPIVersion200
#endif
#define CMPICurrentVersion CMPI_VERSION

/* ---- Encapsulated objects and function tables; their layouts stand in cmpift.h ---- */

typedef struct _CMPIBroker CMPIBroker;
typedef struct _CMPIBrokerFT CMPIBrokerFT;
typedef struct _CMPIBrokerEncFT CMPIBrokerEncFT;
typedef struct _CMPIBrokerExtFT CMPIBrokerExtFT;
typedef struct _CMPIBrokerMemFT CMPIBrokerMemFT;
typedef struct _CMPIContext CMPIContext;
typedef struct _CMPIContextFT CMPIContextFT;
typedef struct _CMPIResult CMPIResult;
typedef struct _CMPIResultFT CMPIResultFT;
typedef struct _CMPIString CMPIString;
typedef struct _CMPIStringFT CMPIStringFT;
typedef struct _CMPIArray CMPIArray;
typedef struct _CMPIArrayFT CMPIArrayFT;
typedef struct _CMPIEnumeration CMPIEnumeration;
typedef struct _CMPIEnumerationFT CMPIEnumerationFT;
typedef struct _CMPIInstance CMPIInstance;
typedef struct _CMPIInstanceFT CMPIInstanceFT;
typedef struct _CMPIObjectPath CMPIObjectPath;
typedef struct _CMPIObjectPathFT CMPIObjectPathFT;
typedef struct _CMPIArgs CMPIArgs;
typedef struct _CMPIArgsFT CMPIArgsFT;
typedef struct _CMPIDateTime CMPIDateTime;
typedef struct _CMPIDateTimeFT CMPIDateTimeFT;
typedef struct _CMPISelectExp CMPISelectExp;
typedef struct _CMPISelectExpFT CMPISelectExpFT;
typedef struct _CMPISelectCond CMPISelectCond;
typedef struct _CMPISelectCondFT CMPISelectCondFT;
typedef struct _CMPISubCond CMPISubCond;
typedef struct _CMPISubCondFT CMPISubCondFT;
typedef struct _CMPIPredicate CMPIPredicate;
typedef struct _CMPIPredicateFT CMPIPredicateFT;
typedef struct _CMPIError CMPIError;
typedef struct _CMPIErrorFT CMPIErrorFT;
typedef struct _CMPIInstanceMI CMPIInstanceMI;
typedef struct _CMPIInstanceMIFT CMPIInstanceMIFT;
typedef struct _CMPIAssociationMI CMPIAssociationMI;
typedef struct _CMPIAssociationMIFT CMPIAssociationMIFT;
typedef struct _CMPIMethodMI CMPIMethodMI;
typedef struct _CMPIMethodMIFT CMPIMethodMIFT;
typedef struct _CMPIPropertyMI CMPIPropertyMI;
typedef struct _CMPIPropertyMIFT CMPIPropertyMIFT;
typedef struct _CMPIIndicationMI CMPIIndicationMI;
typedef struct _CMPIIndicationMIFT CMPIIndicationMIFT;
typedef struct _CMPIGcStat CMPIGcStat; /* opaque; belongs to the object manager */
typedef void* CMPIMsgFileHandle;

/* ---- Plain values ---- */

typedef unsigned char CMPIBoolean; /* 0 or 1 */
typedef unsigned short CMPIChar16;
typedef uint8_t CMPIUint8;
typedef uint16_t CMPIUint16;
typedef uint32_t CMPIUint32;
typedef uint64_t CMPIUint64;
typedef int8_t CMPISint8;
typedef int16_t CMPISint16;
typedef int32_t CMPISint32;
typedef int64_t CMPISint64;
typedef float CMPIReal32;
typedef double CMPIReal64;

typedef unsigned int CMPICount;
typedef unsigned int CMPIVersion;
typedef unsigned int CMPIFlags;
typedef unsigned short CMPIType;
typedef unsigned short CMPIValueState;

/* A block of memory whose length travels with it. */
typedef struct _CMPIValuePtr {
    void* ptr;
    CMPICount length;
} CMPIValuePtr;

/* One value; the CMPIType beside it says which member holds it. */
typedef union _CMPIValue {
    CMPIUint64 uint64;
    CMPIUint32 uint32;
    CMPIUint16 uint16;
    CMPIUint8 uint8;
    CMPISint64 sint64;
    CMPISint32 sint32;
    CMPISint16 sint16;
    CMPISint8 sint8;
    CMPIReal64 real64;
    CMPIReal32 real32;
    CMPIBoolean boolean;
    CMPIChar16 char16;

    CMPIInstance* inst;
    CMPIObjectPath* ref;
    CMPIArgs* args;
    CMPISelectExp* filter;
    CMPIEnumeration* Enum;
    CMPIArray* array;
    CMPIString* string;
    char* chars;
    CMPIDateTime* dateTime;
    CMPIValuePtr dataPtr;

    CMPISint8 Byte;
    CMPISint16 Short;
    CMPISint32 Int;
    CMPISint64 Long;
    CMPIReal32 Float;
    CMPIReal64 Double;
} CMPIValue;

/* ---- Type codes ---- */

#define CMPI_null    0x0000
#define CMPI_SIMPLE  0x0002
#define CMPI_boolean 0x0002
#define CMPI_char16  0x0003
#define CMPI_REAL    0x0008
#define CMPI_real32  0x0008
#define CMPI_real64  0x000C
#define CMPI_UINT    0x0080
#define CMPI_uint8   0x0080
#define CMPI_uint16  0x0090
#define CMPI_uint32  0x00A0
#define CMPI_uint64  0x00B0
#define CMPI_SINT    0x00C0
#define CMPI_sint8   0x00C0
#define CMPI_sint16  0x00D0
#define CMPI_sint32  0x00E0
#define CMPI_sint64  0x00F0
#define CMPI_INTEGER 0x00C0

#define CMPI_ENC         0x1000
#define CMPI_instance    0x1000
#define CMPI_ref         0x1100
#define CMPI_args        0x1200
#define CMPI_class       0x1300
#define CMPI_filter      0x1400
#define CMPI_enumeration 0x1500
#define CMPI_string      0x1600
#define CMPI_chars       0x1700
#define CMPI_dateTime    0x1800
#define CMPI_ptr         0x1900
#define CMPI_charsptr    0x1A00

/* An array type is its element type with the array bit. */
#define CMPI_ARRAY     0x2000
#define CMPI_SIMPLEA   0x2002
#define CMPI_booleanA  0x2002
#define CMPI_char16A   0x2003
#define CMPI_REALA     0x2008
#define CMPI_real32A   0x2008
#define CMPI_real64A   0x200C
#define CMPI_UINTA     0x2080
#define CMPI_uint8A    0x2080
#define CMPI_uint16A   0x2090
#define CMPI_uint32A   0x20A0
#define CMPI_uint64A   0x20B0
#define CMPI_SINTA     0x20C0
#define CMPI_sint8A    0x20C0
#define CMPI_sint16A   0x20D0
#define CMPI_sint32A   0x20E0
#define CMPI_sint64A   0x20F0
#define CMPI_INTEGERA  0x20C0
#define CMPI_ENCA      0x3000
#define CMPI_instanceA 0x3000
#define CMPI_refA      0x3100
#define CMPI_stringA   0x3600
#define CMPI_charsA    0x3700
#define CMPI_dateTimeA 0x3800
#define CMPI_charsptrA 0x3A00

/* Key types as they arrive in an untyped key binding. */
#define CMPI_keyInteger      0x00F0
#define CMPI_keyString       0x1600
#define CMPI_keyBoolean      0x0002
#define CMPI_keyRef          0x1100
#define CMPI_charString      0x1600
#define CMPI_integerString   0x16F0
#define CMPI_realString      0x160C
#define CMPI_numericString   0x16FC
#define CMPI_booleanString   0x1602
#define CMPI_dateTimeString  0x1E00
#define CMPI_classNameString 0x1700
#define CMPI_nameString      0x1E00

/* Names of an older revision of the interface. */
#define CMPI_Byte    0x00C0
#define CMPI_Short   0x00D0
#define CMPI_Int     0x00E0
#define CMPI_Long    0x00F0
#define CMPI_Float   0x0008
#define CMPI_Double  0x000C
#define CMPI_ByteA   0x20C0
#define CMPI_ShortA  0x20D0
#define CMPI_IntA    0x20E0
#define CMPI_LongA   0x20F0
#define CMPI_FloatA  0x2008
#define CMPI_DoubleA 0x200C

/* ---- State of a value: a set of bits ---- */

#define CMPI_goodValue 0x0000
#define CMPI_nullValue 0x0100
#define CMPI_keyValue  0x0200
#define CMPI_notFound  0x0400
#define CMPI_badValue  0x8000

/* A value with its type and state. */
typedef struct _CMPIData {
    CMPIType type;
    CMPIValueState state;
    CMPIValue value;
} CMPIData;

/* ---- Context entries and invocation flags ---- */

#define CMPI_FLAG_LocalOnly          1
#define CMPI_FLAG_DeepInheritance    2
#define CMPI_FLAG_IncludeQualifiers  4
#define CMPI_FLAG_IncludeClassOrigin 8

#define CMPIInitNameSpace    "CMPIInitNameSpace"
#define CMPIInvocationFlags  "CMPIInvocationFlags"
#define CMPIPrincipal        "CMPIPrincipal"
#define CMPIRole             "CMPIRole"
#define CMPIAcceptLanguage   "CMPIAcceptLanguage"
#define CMPIContentLanguage  "CMPIContentLanguage"

/* ---- What a broker offers: bits of CMPIBrokerFT::brokerCapabilities ---- */

#define CMPI_MB_BasicRead                0x0001
#define CMPI_MB_BasicWrite               0x0003
#define CMPI_MB_InstanceManipulation     0x0007
#define CMPI_MB_AssociationTraversal     0x0009
#define CMPI_MB_QueryExecution           0x0011
#define CMPI_MB_QueryNormalization       0x0031
#define CMPI_MB_BasicQualifierSupport    0x0047
#define CMPI_MB_Indications              0x0081
#define CMPI_MB_OSEncapsulationSupport   0x0100
#define CMPI_MB_Supports_MemEnhancements 0x4000
#define CMPI_MB_Supports_Extended_Error  0x8000
#define CMPI_MB_Class_0                  0x0001
#define CMPI_MB_Class_1                  0x0003
#define CMPI_MB_Class_2                  0x0007

/* ---- Return codes; 1 to 29 are the CIM status codes ---- */

typedef enum _CMPIrc {
    CMPI_RC_OK = 0,
    CMPI_RC_ERR_FAILED = 1,
    CMPI_RC_ERR_ACCESS_DENIED = 2,
    CMPI_RC_ERR_INVALID_NAMESPACE = 3,
    CMPI_RC_ERR_INVALID_PARAMETER = 4,
    CMPI_RC_ERR_INVALID_CLASS = 5,
    CMPI_RC_ERR_NOT_FOUND = 6,
    CMPI_RC_ERR_NOT_SUPPORTED = 7,
    CMPI_RC_ERR_CLASS_HAS_CHILDREN = 8,
    CMPI_RC_ERR_CLASS_HAS_INSTANCES = 9,
    CMPI_RC_ERR_INVALID_SUPERCLASS = 10,
    CMPI_RC_ERR_ALREADY_EXISTS = 11,
    CMPI_RC_ERR_NO_SUCH_PROPERTY = 12,
    CMPI_RC_ERR_TYPE_MISMATCH = 13,
    CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED = 14,
    CMPI_RC_ERR_INVALID_QUERY = 15,
    CMPI_RC_ERR_METHOD_NOT_AVAILABLE = 16,
    CMPI_RC_ERR_METHOD_NOT_FOUND = 17,
    CMPI_RC_NO_MORE_ELEMENTS = 18,
    CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED = 27,
    CMPI_RC_ERR_QUERY_FEATURE_NOT_SUPPORTED = 29,
    CMPI_RC_DO_NOT_UNLOAD = 50,
    CMPI_RC_NEVER_UNLOAD = 51,
    CMPI_RC_ERR_INVALID_HANDLE = 60,
    CMPI_RC_ERR_INVALID_DATA_TYPE = 61,
    CMPI_RC_ERR_NOT_IN_CODEPAGE = 62,
    CMPI_RC_ERROR_SYSTEM = 100,
    CMPI_RC_ERROR = 200
} CMPIrc;

/* The outcome of an operation. The message, if any, belongs to the object manager. */
typedef struct _CMPIStatus {
    CMPIrc rc;
    CMPIString* msg;
} CMPIStatus;

/* ---- Queries ---- */

typedef enum _CMPIPredOp {
    CMPI_PredOp_Equals = 1,
    CMPI_PredOp_NotEquals = 2,
    CMPI_PredOp_LessThan = 3,
    CMPI_PredOp_GreaterThanOrEquals = 4,
    CMPI_PredOp_GreaterThan = 5,
    CMPI_PredOp_LessThanOrEquals = 6,
    CMPI_PredOp_Isa = 7,
    CMPI_PredOp_NotIsa = 8,
    CMPI_PredOp_Like = 9,
    CMPI_PredOp_NotLike = 10,
    CMPI_PredOp_Not_Null = 11,
    CMPI_PredOp_Null = 12,
    CMPI_PredOp_And = 13,
    CMPI_PredOp_Or = 14
} CMPIPredOp;

/* Yields the value of a named property of the object under evaluation. */
typedef CMPIData CMPIAccessor(const char* name, void* parameter);

/* ---- Logging and tracing ---- */

typedef enum _CMPISeverity {
    CMPI_SEV_ERROR = 1,
    CMPI_SEV_INFO = 2,
    CMPI_SEV_WARNING = 3,
    CMPI_DEV_DEBUG = 4
} CMPISeverity;

typedef enum _CMPILevel {
    CMPI_LEV_INFO = 1,
    CMPI_LEV_WARNING = 2,
    CMPI_LEV_VERBOSE = 3
} CMPILevel;

/* ---- Errors ---- */

typedef enum _CMPIErrorType {
    UnknownErrorType = 0,
    OtherErrorType = 1,
    CommunicationsError = 2,
    QualityOfServiceError = 3,
    SoftwareError = 4,
    HardwareError = 5,
    EnvironmentalError = 6,
    SecurityError = 7,
    OversubscriptionError = 8,
    Oversubscription_Error = 8,
    UnavailableResourceError = 9,
    UnsupportedOperationError = 10
} CMPIErrorType;

typedef enum _CMPIErrorSeverity {
    ErrorSevUnknown = 0,
    ErrorSevLow = 2,
    ErrorSevMedium = 3,
    ErrorSevHigh = 4,
    ErrorSevFatal = 5
} CMPIErrorSeverity;

typedef enum _CMPIErrorProbableCause {
    ErrorProbCauseUnknown = 0,
    ErrorProbCauseOther = 1,
    Adapter_Card_Error = 2,
    Application_Subsystem_Failure = 3,
    Bandwidth_Reduced = 4,
    Connection_Establishment_Error = 5,
    Communications_Protocol_Error = 6,
    Communications_Subsystem_Failure = 7,
    ConfigurationCustomization_Error = 8,
    Congestion = 9,
    Corrupt_Data = 10,
    CPU_Cycles_Limit_Exceeded = 11,
    DatasetModem_Error = 12,
    Degraded_Signal = 13,
    DTE_DCE_Interface_Error = 14,
    Enclosure_Door_Open = 15,
    Equipment_Malfunction = 16,
    Excessive_Vibration = 17,
    File_Format_Error = 18,
    Fire_Detected = 19,
    Flood_Detected = 20,
    Framing_Error = 21,
    HVAC_Problem = 22,
    Humidity_Unacceptable = 23,
    IO_Device_Error = 24,
    Input_Device_Error = 25,
    LAN_Error = 26,
    Non_Toxic_Leak_Detected = 27,
    Local_Node_Transmission_Error = 28,
    Loss_of_Frame = 29,
    Loss_of_Signal = 30,
    Material_Supply_Exhausted = 31,
    Multiplexer_Problem = 32,
    Out_of_Memory = 33,
    Output_Device_Error = 34,
    Performance_Degraded = 35,
    Power_Problem = 36,
    Pressure_Unacceptable = 37,
    Processor_Problem = 38,
    Pump_Failure = 39,
    Queue_Size_Exceeded = 40,
    Receive_Failure = 41,
    Receiver_Failure = 42,
    Remote_Node_Transmission_Error = 43,
    Resource_at_or_Nearing_Capacity = 44,
    Response_Time_Excessive = 45,
    Retransmission_Rate_Excessive = 46,
    Software_Error = 47,
    Software_Program_Abnormally_Terminated = 48,
    Software_Program_Error = 49,
    Storage_Capacity_Problem = 50,
    Temperature_Unacceptable = 51,
    Threshold_Crossed = 52,
    Timing_Problem = 53,
    Toxic_Leak_Detected = 54,
    Transmit_Failure = 55,
    Transmitter_Failure = 56,
    Underlying_Resource_Unavailable = 57,
    Version_Mismatch = 58,
    Previous_Alert_Cleared = 59,
    Login_Attempts_Failed = 60,
    Software_Virus_Detected = 61,
    Hardware_Security_Breached = 62,
    Denial_of_Service_Detected = 63,
    Security_Credential_Mismatch = 64,
    Unauthorized_Access = 65,
    Alarm_Received = 66,
    Loss_of_Pointer = 67,
    Payload_Mismatch = 68,
    Transmission_Error = 69,
    Excessive_Error_Rate = 70,
    Trace_Problem = 71,
    Element_Unavailable = 72,
    Element_Missing = 73,
    Loss_of_Multi_Frame = 74,
    Broadcast_Channel_Failure = 75,
    Invalid_Message_Received = 76,
    Routing_Failure = 77,
    Backplane_Failure = 78,
    Identifier_Duplication = 79,
    Protection_Path_Failure = 80,
    Sync_Loss_or_Mismatch = 81,
    Terminal_Problem = 82,
    Real_Time_Clock_Failure = 83,
    Antenna_Failure = 84,
    Battery_Charging_Failure = 85,
    Disk_Failure = 86,
    Frequency_Hopping_Failure = 87,
    Loss_of_Redundancy = 88,
    Power_Supply_Failure = 89,
    Signal_Quality_Problem = 90,
    Battery_Discharging = 91,
    Battery_Failure = 92,
    Commercial_Power_Problem = 93,
    Fan_Failure = 94,
    Engine_Failure = 95,
    Sensor_Failure = 96,
    Fuse_Failure = 97,
    Generator_Failure = 98,
    Low_Battery = 99,
    Low_Fuel = 100,
    Low_Water = 101,
    Explosive_Gas = 102,
    High_Winds = 103,
    Ice_Buildup = 104,
    Smoke = 105,
    Memory_Mismatch = 106,
    Out_of_CPU_Cycles = 107,
    Software_Environment_Problem = 108,
    Software_Download_Failure = 109,
    Element_Reinitialized = 110,
    Timeout = 111,
    Logging_Problems = 112,
    Leak_Detected = 113,
    Protection_Mechanism_Failure = 114,
    Protecting_Resource_Failure = 115,
    Database_Inconsistency = 116,
    Authentication_Failure = 117,
    Breach_of_Confidentiality = 118,
    Cable_Tamper = 119,
    Delayed_Information = 120,
    Duplicate_Information = 121,
    Information_Missing = 122,
    Information_Modification = 123,
    Information_Out_of_Sequence = 124,
    Key_Expired = 125,
    Non_Repudiation_Failure = 126,
    Out_of_Hours_Activity = 127,
    Out_of_Service = 128,
    Procedural_Error = 129,
    Unexpected_Information = 130
} CMPIErrorProbableCause;

typedef enum _CMPIErrorSrcFormat {
    CMPIErrSrcUnknown = 0,
    CMPIErrSrcOther = 1,
    CIMObjectHandle = 2
} CMPIErrorSrcFormat;

#ifdef __cplusplus
}
#endif

#endif
