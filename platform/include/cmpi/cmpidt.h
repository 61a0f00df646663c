/* CMPI data types: scalars, values, status, codes. Function tables are in cmpift.h. */
#ifndef _CMPIDT_H_
#define _CMPIDT_H_

#include "cmpios.h"
#include "cmpipl.h"

/* Version numbers: what a table's ftVersion says, major times 100. Those below 100 are older than the standard. */
#define CMPIVersion051 51
#define CMPIVersion060 60
#define CMPIVersion070 70
#define CMPIVersion080 80
#define CMPIVersion085 85
#define CMPIVersion086 86
#define CMPIVersion087 87
#define CMPIVersion090 90
#define CMPIVersion100 100
#define CMPIVersion200 200
#define CMPIVersion210 210

/*
 * The level that a translation unit is compiled for. -DCMPI_VERSION=100 asks for the older interface; otherwise it is
 * 200. CMPI_VER_nnn is defined when that level's features are there, and each level implies the ones below it. At level
 * 100 every table ends where its level 200 additions would begin.
 */
#if !defined(CMPI_VERSION) || CMPI_VERSION == 200
#define CMPI_VER_200 1
#elif CMPI_VERSION != 100
#error "CMPI_VERSION must be 100 or 200"
#endif
#define CMPI_VER_100 1
#define CMPI_VER_90 1
#define CMPI_VER_87 1
#define CMPI_VER_86 1
#define CMPI_VER_85 1
#define CMPI_VER_80 1

/* The number that the provider stubs put into their tables. CMPI_VER_ALL makes it the highest at any level. */
#if defined(CMPI_VER_200) || defined(CMPI_VER_ALL)
#define CMPICurrentVersion CMPIVersion200
#else
#define CMPICurrentVersion CMPIVersion100
#endif

#ifdef __cplusplus
extern "C" {
#endif

/*
 * Objects: two words, a private handle and the table of the object's functions. cmpift.h defines them and their tables.
 */
typedef struct _CMPIBroker CMPIBroker;
typedef struct _CMPIContext CMPIContext;
typedef struct _CMPIResult CMPIResult;
typedef struct _CMPIString CMPIString;
typedef struct _CMPIArray CMPIArray;
typedef struct _CMPIEnumeration CMPIEnumeration;
typedef struct _CMPIInstance CMPIInstance;
typedef struct _CMPIObjectPath CMPIObjectPath;
typedef struct _CMPIArgs CMPIArgs;
typedef struct _CMPIDateTime CMPIDateTime;
typedef struct _CMPISelectExp CMPISelectExp;
typedef struct _CMPISelectCond CMPISelectCond;
typedef struct _CMPISubCond CMPISubCond;
typedef struct _CMPIPredicate CMPIPredicate;

/* The parts of a provider, one for each kind of request it serves. */
typedef struct _CMPIInstanceMI CMPIInstanceMI;
typedef struct _CMPIAssociationMI CMPIAssociationMI;
typedef struct _CMPIMethodMI CMPIMethodMI;
typedef struct _CMPIPropertyMI CMPIPropertyMI;
typedef struct _CMPIIndicationMI CMPIIndicationMI;

/* Function tables. */
typedef struct _CMPIBrokerFT CMPIBrokerFT;
typedef struct _CMPIBrokerEncFT CMPIBrokerEncFT;
typedef struct _CMPIBrokerExtFT CMPIBrokerExtFT;
typedef struct _CMPIContextFT CMPIContextFT;
typedef struct _CMPIResultFT CMPIResultFT;
typedef struct _CMPIObjectPathFT CMPIObjectPathFT;
typedef struct _CMPIInstanceFT CMPIInstanceFT;
typedef struct _CMPIArgsFT CMPIArgsFT;
typedef struct _CMPIStringFT CMPIStringFT;
typedef struct _CMPIArrayFT CMPIArrayFT;
typedef struct _CMPIEnumerationFT CMPIEnumerationFT;
typedef struct _CMPIDateTimeFT CMPIDateTimeFT;
typedef struct _CMPISelectExpFT CMPISelectExpFT;
typedef struct _CMPISelectCondFT CMPISelectCondFT;
typedef struct _CMPISubCondFT CMPISubCondFT;
typedef struct _CMPIPredicateFT CMPIPredicateFT;
typedef struct _CMPIInstanceMIFT CMPIInstanceMIFT;
typedef struct _CMPIAssociationMIFT CMPIAssociationMIFT;
typedef struct _CMPIMethodMIFT CMPIMethodMIFT;
typedef struct _CMPIPropertyMIFT CMPIPropertyMIFT;
typedef struct _CMPIIndicationMIFT CMPIIndicationMIFT;

#ifdef CMPI_VER_200
typedef struct _CMPIError CMPIError;
typedef struct _CMPIErrorFT CMPIErrorFT;
typedef struct _CMPIBrokerMemFT CMPIBrokerMemFT;
#endif

/* CIM's intrinsic types. The 64-bit ones are long long, also where long is as wide. */
typedef unsigned char CMPIBoolean;
typedef unsigned short CMPIChar16;
typedef unsigned char CMPIUint8;
typedef unsigned short CMPIUint16;
typedef unsigned int CMPIUint32;
typedef unsigned long long CMPIUint64;
typedef signed char CMPISint8;
typedef short CMPISint16;
typedef int CMPISint32;
typedef long long CMPISint64;
typedef float CMPIReal32;
typedef double CMPIReal64;

typedef int CMPIVersion;               /* a version number, see above */
typedef unsigned int CMPICount;        /* a number of items, or an index from 0 */
typedef unsigned short CMPIType;       /* CMPI_uint8 ... */
typedef unsigned short CMPIValueState; /* CMPI_goodValue or the bits below it */
typedef unsigned int CMPIFlags;        /* CMPI_FLAG_... bits */
typedef void* CMPIMsgFileHandle;       /* an open message file; null: none */
typedef void CMPIGcStat;               /* a mark in the broker's list of objects to free */

/* Functions that a provider hands to the broker's thread services. */
typedef CMPI_THREAD_RETURN(CMPI_THREAD_CDECL* CMPIThreadFunc)(void*);
typedef void (*CMPIThreadOnceFunc)(void);
typedef void (*CMPIThreadKeyCleanupFunc)(void*);

/* Any bytes, for context entries of type CMPI_ptr. */
typedef struct _CMPIValuePtr {
    void* ptr;
    CMPICount length; /* in bytes */
} CMPIValuePtr;

/* One value; the type code that travels with it says which member counts. */
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

/* A value with its type, and whether it is null, a key or absent. */
typedef struct _CMPIData {
    CMPIType type;
    CMPIValueState state;
    CMPIValue value;
} CMPIData;

/* Reads one property for an expression that is evaluated without an instance. */
typedef CMPIData CMPIAccessor(const char* propertyName, void* parm);

/*
 * Type codes. Small numbers are intrinsic types, multiples of 0x100 from 0x1000 on are objects, and CMPI_ARRAY makes an
 * array of either. The group masks (upper case) share their number with the first member of the group, and CMPI_SINT
 * contains the bit of CMPI_UINT: compare (type & (CMPI_UINT | CMPI_SINT)) with one of the two.
 */
#define CMPI_null 0x0000
#define CMPI_SIMPLE 0x0002
#define CMPI_boolean 0x0002
#define CMPI_char16 0x0003
#define CMPI_REAL 0x0008
#define CMPI_real32 0x0008
#define CMPI_real64 0x000C
#define CMPI_UINT 0x0080
#define CMPI_uint8 0x0080
#define CMPI_uint16 0x0090
#define CMPI_uint32 0x00A0
#define CMPI_uint64 0x00B0
#define CMPI_SINT 0x00C0
#define CMPI_sint8 0x00C0
#define CMPI_sint16 0x00D0
#define CMPI_sint32 0x00E0
#define CMPI_sint64 0x00F0
#define CMPI_INTEGER 0x00C0

#define CMPI_ENC 0x1000
#define CMPI_instance 0x1000
#define CMPI_ref 0x1100
#define CMPI_args 0x1200
#define CMPI_class 0x1300
#define CMPI_filter 0x1400
#define CMPI_enumeration 0x1500
#define CMPI_string 0x1600
#define CMPI_chars 0x1700 /* passed in, the value pointer is the text itself; getters give a CMPI_string */
#define CMPI_dateTime 0x1800
#define CMPI_ptr 0x1900
#define CMPI_charsptr 0x1A00 /* passed in, the value pointer is the address of a char* */

#define CMPI_ARRAY 0x2000
#define CMPI_SIMPLEA 0x2002
#define CMPI_booleanA 0x2002
#define CMPI_char16A 0x2003
#define CMPI_REALA 0x2008
#define CMPI_real32A 0x2008
#define CMPI_real64A 0x200C
#define CMPI_UINTA 0x2080
#define CMPI_uint8A 0x2080
#define CMPI_uint16A 0x2090
#define CMPI_uint32A 0x20A0
#define CMPI_uint64A 0x20B0
#define CMPI_SINTA 0x20C0
#define CMPI_sint8A 0x20C0
#define CMPI_sint16A 0x20D0
#define CMPI_sint32A 0x20E0
#define CMPI_sint64A 0x20F0
#define CMPI_INTEGERA 0x20C0
#define CMPI_ENCA 0x3000
#define CMPI_stringA 0x3600
#define CMPI_charsA 0x3700
#define CMPI_dateTimeA 0x3800
#define CMPI_instanceA 0x3000
#define CMPI_refA 0x3100
#define CMPI_charsptrA 0x3A00

/* Keys of which only the general kind is known, as in a path that came as text. */
#define CMPI_keyInteger 0x00F0
#define CMPI_keyString 0x1600
#define CMPI_keyBoolean 0x0002
#define CMPI_keyRef 0x1100

/* Operands of query predicates only. */
#define CMPI_charString 0x1600
#define CMPI_integerString 0x16F0
#define CMPI_realString 0x160C
#define CMPI_numericString 0x16FC
#define CMPI_booleanString 0x1602
#define CMPI_dateTimeString 0x1E00
#define CMPI_classNameString 0x1700
#define CMPI_nameString 0x1E00

/* Second names of type codes. */
#ifndef CMPI_NO_SYNONYM_SUPPORT
#define CMPI_Byte CMPI_sint8
#define CMPI_Short CMPI_sint16
#define CMPI_Int CMPI_sint32
#define CMPI_Long CMPI_sint64
#define CMPI_Float CMPI_real32
#define CMPI_Double CMPI_real64
#define CMPI_ByteA CMPI_sint8A
#define CMPI_ShortA CMPI_sint16A
#define CMPI_IntA CMPI_sint32A
#define CMPI_LongA CMPI_sint64A
#define CMPI_FloatA CMPI_real32A
#define CMPI_DoubleA CMPI_real64A
#endif

/* State bits of a CMPIData. */
#define CMPI_goodValue 0x0000 /* none of them: a value that is neither null nor a key */
#define CMPI_nullValue 0x0100
#define CMPI_keyValue 0x0200 /* a key binding; may stand with others */
#define CMPI_notFound 0x0400 /* no item of that name */
#define CMPI_badValue 0x8000 /* the value cannot be used */

/* Return codes. 0 to 18, 27 and 29 have the numbers of the CIM status codes. */
typedef enum _CMPIrc {
    CMPI_RC_OK = 0,                                /* success */
    CMPI_RC_ERR_FAILED = 1,                        /* unspecific failure */
    CMPI_RC_ERR_ACCESS_DENIED = 2,                 /* caller not authorised */
    CMPI_RC_ERR_INVALID_NAMESPACE = 3,             /* namespace unknown */
    CMPI_RC_ERR_INVALID_PARAMETER = 4,             /* bad argument */
    CMPI_RC_ERR_INVALID_CLASS = 5,                 /* class unknown */
    CMPI_RC_ERR_NOT_FOUND = 6,                     /* item absent */
    CMPI_RC_ERR_NOT_SUPPORTED = 7,                 /* operation not offered */
    CMPI_RC_ERR_CLASS_HAS_CHILDREN = 8,            /* subclasses exist */
    CMPI_RC_ERR_CLASS_HAS_INSTANCES = 9,           /* instances exist */
    CMPI_RC_ERR_INVALID_SUPERCLASS = 10,           /* bad superclass */
    CMPI_RC_ERR_ALREADY_EXISTS = 11,               /* already there */
    CMPI_RC_ERR_NO_SUCH_PROPERTY = 12,             /* property, key, argument, entry or index absent */
    CMPI_RC_ERR_TYPE_MISMATCH = 13,                /* wrong type */
    CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED = 14, /* query language unknown */
    CMPI_RC_ERR_INVALID_QUERY = 15,                /* query malformed */
    CMPI_RC_ERR_METHOD_NOT_AVAILABLE = 16,         /* method known, not offered */
    CMPI_RC_ERR_METHOD_NOT_FOUND = 17,             /* method unknown */
    CMPI_RC_NO_MORE_ELEMENTS = 18,                 /* the end of an enumeration */
    CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED = 27,       /* more than the server can do now */
    CMPI_RC_ERR_QUERY_FEATURE_NOT_SUPPORTED = 29,  /* query asks for what the language processor lacks */
    CMPI_RC_DO_NOT_UNLOAD = 50,                    /* from cleanup only: ask again later */
    CMPI_RC_NEVER_UNLOAD = 51,                     /* from cleanup only: keep until shutdown */
    CMPI_RC_ERR_INVALID_HANDLE = 60,               /* object handle unusable */
    CMPI_RC_ERR_INVALID_DATA_TYPE = 61,            /* type code unusable here */
    CMPI_RC_ERR_NOT_IN_CODEPAGE = 62,              /* text has characters that the code page lacks */
    CMPI_RC_ERROR_SYSTEM = 100,                    /* reserved for errors of the operating system, as is the next */
    CMPI_RC_ERROR = 200
} CMPIrc;

/* How a call ended. The text is the broker's; whoever gets it reads it before the request ends. */
typedef struct _CMPIStatus {
    CMPIrc rc;
    CMPIString* msg; /* null: no text */
} CMPIStatus;

/* Bits of the context entry CMPIInvocationFlags. */
#define CMPI_FLAG_LocalOnly 1
#define CMPI_FLAG_DeepInheritance 2
#define CMPI_FLAG_IncludeQualifiers 4
#define CMPI_FLAG_IncludeClassOrigin 8

/* Names of context entries. */
#define CMPIInitNameSpace "CMPIInitNameSpace"     /* CMPI_string: a namespace that the provider is loaded for */
#define CMPIInvocationFlags "CMPIInvocationFlags" /* CMPI_uint32: CMPI_FLAG_... bits */
#define CMPIPrincipal "CMPIPrincipal"             /* CMPI_string: the user who asks */
#define CMPIRole "CMPIRole"                       /* CMPI_string: that user's role; empty: unknown */
#define CMPIAcceptLanguage "CMPIAcceptLanguage"   /* CMPI_string: languages wanted, as HTTP writes them */
#define CMPIContentLanguage "CMPIContentLanguage" /* CMPI_string: language of the data */

/*
 * What a broker can do. A capability contains the bits of those it builds on: test (caps & MASK) == MASK. The first
 * group is older than the standard; its bits overlap with the later ones.
 */
#define CMPI_MB_Class_0 0x00000001
#define CMPI_MB_Class_1 0x00000003
#define CMPI_MB_Class_2 0x00000007
#define CMPI_MB_Supports_PropertyMI 0x00000100
#define CMPI_MB_Supports_IndicationMI 0x00000200
#define CMPI_MB_Supports_IndicationPolling 0x00000400
#define CMPI_MB_Supports_QueryNormalization 0x00000800
#define CMPI_MB_Supports_Qualifier 0x00001000
#define CMPI_MB_Supports_Schema 0x00003000

#define CMPI_MB_BasicRead 0x00000001
#define CMPI_MB_BasicWrite 0x00000003
#define CMPI_MB_InstanceManipulation 0x00000007
#define CMPI_MB_AssociationTraversal 0x00000009
#define CMPI_MB_QueryExecution 0x00000011
#define CMPI_MB_QueryNormalization 0x00000031
#define CMPI_MB_Indications 0x00000081
#define CMPI_MB_BasicQualifierSupport 0x00000047
#define CMPI_MB_OSEncapsulationSupport 0x00000100
#ifdef CMPI_VER_200
#define CMPI_MB_Supports_MemEnhancements 0x00004000 /* without it the broker's mft is null */
#define CMPI_MB_Supports_Extended_Error 0x00008000
#endif
#define CMPI_MB_Logging 0x00010000
#define CMPI_MB_Tracing 0x00020000
#define CMPI_MB_PropertyFiltering 0x00040001
#define CMPI_MB_CodepageConversion 0x00080000

/* Operators of query predicates. */
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
#ifdef CMPI_VER_200
    CMPI_PredOp_Not_Null = 11,
    CMPI_PredOp_Null = 12,
    CMPI_PredOp_And = 13,
    CMPI_PredOp_Or = 14
#endif
} CMPIPredOp;

/* Severities for the log. */
typedef enum _CMPISeverity {
    CMPI_SEV_ERROR = 1,
    CMPI_SEV_INFO = 2,
    CMPI_SEV_WARNING = 3,
    CMPI_DEV_DEBUG = 4
} CMPISeverity;

/* Levels for the trace. */
typedef enum _CMPILevel { CMPI_LEV_INFO = 1, CMPI_LEV_WARNING = 2, CMPI_LEV_VERBOSE = 3 } CMPILevel;

/* Normal forms of a query's condition: an OR of ANDs, or an AND of ORs. */
typedef enum _CMPISelectCondType { CMPI_COND_DOC = 0, CMPI_COND_COD = 1 } CMPISelectCondType;

#ifdef CMPI_VER_200
/* The attributes of a CMPIError. Their enumerators have no prefix: keep clear of these words. */
typedef enum _CMPIErrorType {
    UnknownErrorType = 0,
    OtherErrorType = 1,
    CommunicationsError = 2,
    QualityOfServiceError = 3,
    SoftwareError = 4,
    HardwareError = 5,
    EnvironmentalError = 6,
    SecurityError = 7,
    Oversubscription_Error = 8,
    OversubscriptionError = 8,
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

typedef enum _CMPIErrorSrcFormat { CMPIErrSrcUnknown = 0, CMPIErrSrcOther = 1, CIMObjectHandle = 2 } CMPIErrorSrcFormat;

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
    Leak_Detected_113 = 113,
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
#endif

#ifdef __cplusplus
}
#endif

#endif
