/* The interface of level 100: every table is the beginning of its longer self. Sizes for 64-bit Linux. */
#undef CMPI_VERSION
#define CMPI_VERSION 100
#include "cmpift.h"

#include <stddef.h>

#ifdef __cplusplus
#define CHECK static_assert
#else
#define CHECK _Static_assert
#endif

#ifdef CMPI_VER_200
#error "level 200 must be off"
#endif
#if !defined(CMPI_VER_100) || !defined(CMPI_VER_90) || !defined(CMPI_VER_87) || !defined(CMPI_VER_86) ||               \
    !defined(CMPI_VER_85) || !defined(CMPI_VER_80)
#error "level 100 implies the older ones"
#endif

/* LAST: the slot that ends the table at this level. */
#define LAST(type, member, size)                                                                                       \
    CHECK(sizeof(type) == size && offsetof(type, member) == size - sizeof(void*), #type "." #member);
LAST(CMPIBroker, xft, 32)
LAST(CMPIBrokerFT, getProperty, 160)
LAST(CMPIBrokerEncFT, trace, 136)
LAST(CMPIBrokerExtFT, signalCondition, 168)
LAST(CMPIContextFT, addEntry, 56)
LAST(CMPIResultFT, returnDone, 56)
LAST(CMPIObjectPathFT, toString, 160)
LAST(CMPIInstanceFT, setObjectPath, 80)
LAST(CMPIArgsFT, getArgCount, 56)
LAST(CMPIStringFT, getCharPtr, 32)
LAST(CMPIArrayFT, setElementAt, 56)
LAST(CMPIEnumerationFT, toArray, 48)
LAST(CMPIDateTimeFT, isInterval, 48)
LAST(CMPISelectExpFT, evaluateUsingAccessor, 64)
LAST(CMPISelectCondFT, getSubCondAt, 40)
LAST(CMPISubCondFT, getPredicate, 48)
LAST(CMPIPredicateFT, evaluateUsingAccessor, 40)
LAST(CMPIInstanceMIFT, execQuery, 80)
LAST(CMPIAssociationMIFT, referenceNames, 56)
LAST(CMPIMethodMIFT, invokeMethod, 32)
LAST(CMPIPropertyMIFT, getProperty, 40)
LAST(CMPIIndicationMIFT, disableIndications, 72)

/* These names come with level 200 and are free for others before. */
struct CMPIError {
    int Timeout, Smoke, CMPI_PredOp_And;
};
#if defined(CMPI_MB_Supports_MemEnhancements) || defined(CMReturnError) || defined(CMNewCMPIError) ||                  \
    defined(CMGetMessage2) || defined(CMSetPropertyWithOrigin) || defined(CMGetErrorType)
#error "level 200 macros must be off"
#endif
#if !defined(CMGetMessage) || !defined(CBModifyInstance) || !defined(CMLogMessage) || !defined(CMSetObjectPath)
#error "level 100 macros must be on"
#endif

/* Only the number that stubs write follows the broker's wish for everything. */
#ifdef CMPI_VER_ALL
CHECK(CMPICurrentVersion == 200, "CMPICurrentVersion");
#else
CHECK(CMPICurrentVersion == 100, "CMPICurrentVersion");
#endif
