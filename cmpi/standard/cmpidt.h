/* The data types of the Common Manageability Programming Interface (CMPI) 1.00, a standard of The Open Group: scalars,
 * type codes, value states, return codes and the handles of the objects that a broker hands out.
 *
 * Readable by C and C++. The build names the platform (CMPI_PLATFORM_LINUX_GENERIC_GNU) and the version (CMPI_VERSION=100).
 * The layouts are a binary contract: the function tables in cmpift.h belong to it. */
#pragma once

#if !defined(CMPI_PLATFORM_LINUX_GENERIC_GNU)
#error "define CMPI_PLATFORM_LINUX_GENERIC_GNU: these headers describe CMPI on Linux only"
#endif
#if !defined(CMPI_VERSION) || CMPI_VERSION != 100
#error "define CMPI_VERSION=100: these headers describe CMPI 1.00 only"
#endif

#include <assert.h>
#include <stdint.h>

#ifdef __cplusplus
extern "C"
{
#endif

    typedef uint8_t CMPIBoolean;
    typedef uint16_t CMPIChar16;
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
    typedef uint32_t CMPICount;

    /* The codes of CMPI types. An array's code is its element's with the bit CMPI_ARRAY. */
    typedef uint16_t CMPIType;

/* clang-format off */
#define CMPI_null        0x0000
#define CMPI_boolean     0x0002
#define CMPI_char16      0x0003
#define CMPI_real32      0x0008
#define CMPI_real64      0x000C
#define CMPI_uint8       0x0080
#define CMPI_uint16      0x0090
#define CMPI_uint32      0x00A0
#define CMPI_uint64      0x00B0
#define CMPI_sint8       0x00C0
#define CMPI_sint16      0x00D0
#define CMPI_sint32      0x00E0
#define CMPI_sint64      0x00F0
#define CMPI_instance    0x1000
#define CMPI_ref         0x1100
#define CMPI_args        0x1200
#define CMPI_class       0x1300
#define CMPI_filter      0x1400
#define CMPI_enumeration 0x1500
#define CMPI_string      0x1600
#define CMPI_chars       0x1700 /* the CMPIValue pointer of a call is the text itself */
#define CMPI_dateTime    0x1800
#define CMPI_ptr         0x1900
#define CMPI_charsptr    0x1A00
#define CMPI_ARRAY       0x2000

/* Classes of types. */
#define CMPI_SIMPLE      (CMPI_boolean | CMPI_char16)
#define CMPI_REAL        (CMPI_real32 | CMPI_real64)
#define CMPI_UINT        CMPI_uint8
#define CMPI_SINT        (CMPI_uint8 | 0x0040)
#define CMPI_INTEGER     CMPI_uint8
#define CMPI_ENC         0x1000

#define CMPI_keyInteger  CMPI_sint64
#define CMPI_keyString   CMPI_string
#define CMPI_keyBoolean  CMPI_boolean
#define CMPI_keyRef      CMPI_ref
    /* clang-format on */

    /* The states of a value. */
    typedef uint16_t CMPIValueState;

/* clang-format off */
#define CMPI_goodValue   0x0000
#define CMPI_nullValue   0x0100
#define CMPI_keyValue    0x0200
#define CMPI_notFound    0x0400
#define CMPI_badValue    0x8000
    /* clang-format on */

    /* The flags of an invocation, which its context holds under the name CMPIInvocationFlags. */
    typedef uint32_t CMPIFlags;

/* clang-format off */
#define CMPI_FLAG_LocalOnly          1
#define CMPI_FLAG_DeepInheritance    2
#define CMPI_FLAG_IncludeQualifiers  4
#define CMPI_FLAG_IncludeClassOrigin 8

/* The names of context entries. */
#define CMPIInitNameSpace   "CMPIInitNameSpace"
#define CMPIInvocationFlags "CMPIInvocationFlags"
#define CMPIPrincipal       "CMPIPrincipal"
#define CMPIRole            "CMPIRole"
    /* clang-format on */

    typedef enum _CMPIrc
    {
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

    /* Every object is a handle of its owner and a function table. */
    typedef struct _CMPIBroker CMPIBroker;
    typedef struct _CMPIContext CMPIContext;
    typedef struct _CMPIResult CMPIResult;
    typedef struct _CMPIInstance CMPIInstance;
    typedef struct _CMPIObjectPath CMPIObjectPath;
    typedef struct _CMPIArgs CMPIArgs;
    typedef struct _CMPIString CMPIString;
    typedef struct _CMPIArray CMPIArray;
    typedef struct _CMPIEnumeration CMPIEnumeration;
    typedef struct _CMPIDateTime CMPIDateTime;
    typedef struct _CMPISelectExp CMPISelectExp;
    typedef struct _CMPISelectCond CMPISelectCond;
    typedef struct _CMPISubCond CMPISubCond;
    typedef struct _CMPIPredicate CMPIPredicate;

    typedef struct _CMPIInstanceMI CMPIInstanceMI;
    typedef struct _CMPIAssociationMI CMPIAssociationMI;
    typedef struct _CMPIMethodMI CMPIMethodMI;
    typedef struct _CMPIIndicationMI CMPIIndicationMI;

    typedef struct _CMPIBrokerFT CMPIBrokerFT;
    typedef struct _CMPIBrokerEncFT CMPIBrokerEncFT;
    typedef struct _CMPIBrokerExtFT CMPIBrokerExtFT;
    typedef struct _CMPIContextFT CMPIContextFT;
    typedef struct _CMPIResultFT CMPIResultFT;
    typedef struct _CMPIInstanceFT CMPIInstanceFT;
    typedef struct _CMPIObjectPathFT CMPIObjectPathFT;
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
    typedef struct _CMPIIndicationMIFT CMPIIndicationMIFT;

    typedef struct _CMPIValuePtr
    {
        void* ptr;
        CMPICount length;
    } CMPIValuePtr;

    typedef union _CMPIValue
    {
        CMPIBoolean boolean;
        CMPIChar16 char16;
        CMPIUint8 uint8;
        CMPIUint16 uint16;
        CMPIUint32 uint32;
        CMPIUint64 uint64;
        CMPISint8 sint8;
        CMPISint16 sint16;
        CMPISint32 sint32;
        CMPISint64 sint64;
        CMPIReal32 real32;
        CMPIReal64 real64;
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
    } CMPIValue;
    static_assert(sizeof(CMPIValue) == 16, "layout of CMPIValue");

    typedef struct _CMPIData
    {
        CMPIType type;
        CMPIValueState state;
        CMPIValue value;
    } CMPIData;
    static_assert(sizeof(CMPIData) == 24, "layout of CMPIData");

    typedef struct _CMPIStatus
    {
        CMPIrc rc;
        CMPIString* msg; /* null: no message */
    } CMPIStatus;
    static_assert(sizeof(CMPIStatus) == 16, "layout of CMPIStatus");

    /* Answers the value of a property by its name, for the evaluation of a select expression. */
    typedef CMPIData CMPIAccessor(const char* name, void* parameter);

    /* The operators of a select expression's predicates. */
    typedef enum _CMPIPredOp
    {
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

    /* The threads, mutexes and conditions of a broker. */
    typedef void* CMPI_THREAD_TYPE;
    typedef void* CMPI_THREAD_RETURN;
    typedef void* CMPI_MUTEX_TYPE;
    typedef void* CMPI_COND_TYPE;
    typedef uint32_t CMPI_THREAD_KEY_TYPE;

#ifdef __cplusplus
}
#endif
