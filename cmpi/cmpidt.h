/* SPDX-License-Identifier: Apache-2.0 */
/*
 * CMPI 2.0 data types: scalars, the value union, types, value states, return codes and constants.
 *
 * The numbers and the layout are those that the CMPI standard (The Open Group, C061) fixes for a binary to fit.
 */
#ifndef CMPIDT_H_
#define CMPIDT_H_

#include "cmpipl.h"

#ifdef __cplusplus
extern "C" {
#endif

/* Versions of the interface; a table's ftVersion and a provider's miVersion carry one of them. */
#define CMPIVersion100 100
#define CMPIVersion200 200
#define CMPICurrentVersion CMPIVersion200

/* Scalars */

typedef unsigned int CMPICount;
typedef unsigned int CMPIFlags;
typedef unsigned short CMPIType;
typedef unsigned short CMPIValueState;

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

typedef void* CMPIMsgFileHandle;
typedef void CMPIGcStat;

/* Objects; each is a handle and a function table (cmpift.h). */

typedef struct _CMPIBroker CMPIBroker;
typedef struct _CMPIBrokerFT CMPIBrokerFT;
typedef struct _CMPIBrokerEncFT CMPIBrokerEncFT;
typedef struct _CMPIBrokerExtFT CMPIBrokerExtFT;
typedef struct _CMPIBrokerMemFT CMPIBrokerMemFT;
typedef struct _CMPIContext CMPIContext;
typedef struct _CMPIContextFT CMPIContextFT;
typedef struct _CMPIResult CMPIResult;
typedef struct _CMPIResultFT CMPIResultFT;
typedef struct _CMPIInstance CMPIInstance;
typedef struct _CMPIInstanceFT CMPIInstanceFT;
typedef struct _CMPIObjectPath CMPIObjectPath;
typedef struct _CMPIObjectPathFT CMPIObjectPathFT;
typedef struct _CMPIString CMPIString;
typedef struct _CMPIStringFT CMPIStringFT;
typedef struct _CMPIArray CMPIArray;
typedef struct _CMPIArrayFT CMPIArrayFT;
typedef struct _CMPIEnumeration CMPIEnumeration;
typedef struct _CMPIEnumerationFT CMPIEnumerationFT;
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

/* Values */

typedef struct _CMPIValuePtr {
  void* ptr;
  CMPICount length;
} CMPIValuePtr;

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

/* A value with its type and its state; value means nothing while state has the null bit. */
typedef struct _CMPIData {
  CMPIType type;
  CMPIValueState state;
  CMPIValue value;
} CMPIData;

/* Looks a property up by name for the evaluation of a select expression. */
typedef CMPIData CMPIAccessor(const char* name, void* parameter);

/* Types (CMPIType) */

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
#define CMPI_INTEGER (CMPI_UINT | CMPI_SINT)
#define CMPI_ENC 0x1000
#define CMPI_instance 0x1000
#define CMPI_ref 0x1100
#define CMPI_args 0x1200
#define CMPI_class 0x1300
#define CMPI_filter 0x1400
#define CMPI_enumeration 0x1500
#define CMPI_string 0x1600
#define CMPI_chars 0x1700
#define CMPI_dateTime 0x1800
#define CMPI_ptr 0x1900
#define CMPI_charsptr 0x1A00

/* An array type is its element type with this bit. */
#define CMPI_ARRAY 0x2000
#define CMPI_SIMPLEA (CMPI_ARRAY | CMPI_SIMPLE)
#define CMPI_booleanA (CMPI_ARRAY | CMPI_boolean)
#define CMPI_char16A (CMPI_ARRAY | CMPI_char16)
#define CMPI_REALA (CMPI_ARRAY | CMPI_REAL)
#define CMPI_real32A (CMPI_ARRAY | CMPI_real32)
#define CMPI_real64A (CMPI_ARRAY | CMPI_real64)
#define CMPI_UINTA (CMPI_ARRAY | CMPI_UINT)
#define CMPI_uint8A (CMPI_ARRAY | CMPI_uint8)
#define CMPI_uint16A (CMPI_ARRAY | CMPI_uint16)
#define CMPI_uint32A (CMPI_ARRAY | CMPI_uint32)
#define CMPI_uint64A (CMPI_ARRAY | CMPI_uint64)
#define CMPI_SINTA (CMPI_ARRAY | CMPI_SINT)
#define CMPI_sint8A (CMPI_ARRAY | CMPI_sint8)
#define CMPI_sint16A (CMPI_ARRAY | CMPI_sint16)
#define CMPI_sint32A (CMPI_ARRAY | CMPI_sint32)
#define CMPI_sint64A (CMPI_ARRAY | CMPI_sint64)
#define CMPI_ENCA (CMPI_ARRAY | CMPI_ENC)
#define CMPI_instanceA (CMPI_ARRAY | CMPI_instance)
#define CMPI_refA (CMPI_ARRAY | CMPI_ref)
#define CMPI_argsA (CMPI_ARRAY | CMPI_args)
#define CMPI_classA (CMPI_ARRAY | CMPI_class)
#define CMPI_filterA (CMPI_ARRAY | CMPI_filter)
#define CMPI_enumerationA (CMPI_ARRAY | CMPI_enumeration)
#define CMPI_stringA (CMPI_ARRAY | CMPI_string)
#define CMPI_charsA (CMPI_ARRAY | CMPI_chars)
#define CMPI_dateTimeA (CMPI_ARRAY | CMPI_dateTime)
#define CMPI_ptrA (CMPI_ARRAY | CMPI_ptr)
#define CMPI_charsptrA (CMPI_ARRAY | CMPI_charsptr)

/* The types that key values travel in. */
#define CMPI_keyInteger CMPI_sint64
#define CMPI_keyString CMPI_string
#define CMPI_keyBoolean CMPI_boolean
#define CMPI_keyRef CMPI_ref

/* Value states (CMPIValueState), bits */

#define CMPI_goodValue 0x0000
#define CMPI_nullValue 0x0100
#define CMPI_keyValue 0x0200
#define CMPI_notFound 0x0400
#define CMPI_badValue 0x8000

/* Invocation flags, as the context entry CMPIInvocationFlags carries them. */

#define CMPI_FLAG_LocalOnly 1
#define CMPI_FLAG_DeepInheritance 2
#define CMPI_FLAG_IncludeQualifiers 4
#define CMPI_FLAG_IncludeClassOrigin 8

/* Names of context entries */

#define CMPIPrincipal "CMPIPrincipal"
#define CMPIInvocationFlags "CMPIInvocationFlags"
#define CMPIInitNameSpace "CMPIInitNameSpace"
#define CMPIRole "CMPIRole"
#define CMPIAcceptLanguage "CMPIAcceptLanguage"
#define CMPIContentLanguage "CMPIContentLanguage"

/* Broker capabilities, bits */

#define CMPI_MB_BasicRead 0x0001
#define CMPI_MB_BasicWrite 0x0003
#define CMPI_MB_InstanceManipulation 0x0007
#define CMPI_MB_AssociationTraversal 0x0009
#define CMPI_MB_QueryExecution 0x0011
#define CMPI_MB_QueryNormalization 0x0031
#define CMPI_MB_BasicQualifierSupport 0x0047
#define CMPI_MB_Indications 0x0081
#define CMPI_MB_OSEncapsulationSupport 0x0100
#define CMPI_MB_Supports_MemEnhancements 0x4000
#define CMPI_MB_Supports_Extended_Error 0x8000

/* Severities of CMLogMessage */

#define CMPI_SEV_ERROR 1
#define CMPI_SEV_INFO 2
#define CMPI_SEV_WARNING 3
#define CMPI_DEV_DEBUG 4

/* Levels of CMTraceMessage */

#define CMPI_LEV_INFO 1
#define CMPI_LEV_WARNING 2
#define CMPI_LEV_VERBOSE 3

/* Return codes: those of the CIM operations (DSP0200) up to 17, then the interface's own. */
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
  CMPI_RC_DO_NOT_UNLOAD = 50,
  CMPI_RC_NEVER_UNLOAD = 51,
  CMPI_RC_ERR_INVALID_HANDLE = 60,
  CMPI_RC_ERR_INVALID_DATA_TYPE = 61,
  CMPI_RC_ERROR_SYSTEM = 100,
  CMPI_RC_ERROR = 200
} CMPIrc;

/* The outcome of a call; msg is null or belongs to the object manager. */
typedef struct _CMPIStatus {
  CMPIrc rc;
  CMPIString* msg;
} CMPIStatus;

/* Select conditions: disjunction of conjunctions, or the reverse. */
typedef enum _CMPISelectCondType { CMPI_COND_DOC = 0, CMPI_COND_COD = 1 } CMPISelectCondType;

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
  CMPI_PredOp_NotLike = 10
} CMPIPredOp;

/* The value maps of CIM_Error. */
typedef enum _CMPIErrorType {
  CMPIErrorTypeUnknown = 0,
  CMPIErrorTypeOther = 1,
  CMPIErrorTypeCommunications = 2,
  CMPIErrorTypeQualityOfService = 3,
  CMPIErrorTypeSoftware = 4,
  CMPIErrorTypeHardware = 5,
  CMPIErrorTypeEnvironmental = 6,
  CMPIErrorTypeSecurity = 7,
  CMPIErrorTypeOversubscription = 8,
  CMPIErrorTypeUnavailableResource = 9,
  CMPIErrorTypeUnsupportedOperation = 10
} CMPIErrorType;

typedef enum _CMPIErrorSeverity {
  CMPIErrorSeverityUnknown = 0,
  CMPIErrorSeverityOther = 1,
  CMPIErrorSeverityInformation = 2,
  CMPIErrorSeverityDegradedWarning = 3,
  CMPIErrorSeverityMinor = 4,
  CMPIErrorSeverityMajor = 5,
  CMPIErrorSeverityCritical = 6,
  CMPIErrorSeverityFatalNonRecoverable = 7
} CMPIErrorSeverity;

/* Any number of the value map of CIM_Error.ProbableCause. */
typedef enum _CMPIErrorProbableCause {
  CMPIErrorProbableCauseUnknown = 0,
  CMPIErrorProbableCauseLast = 130
} CMPIErrorProbableCause;

typedef enum _CMPIErrorSrcFormat {
  CMPIErrorSrcFormatUnknown = 0,
  CMPIErrorSrcFormatOther = 1,
  CMPIErrorSrcFormatObjectHandle = 2
} CMPIErrorSrcFormat;

#ifdef __cplusplus
}
#endif

#endif /* CMPIDT_H_ */
