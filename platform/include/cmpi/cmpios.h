/* CMPI operating-system types and linkage macros (Linux). */
#ifndef _CMPIOS_H_
#define _CMPIOS_H_

#include "cmpipl.h"

#include <stdlib.h>

/* What the broker's thread services hand out; opaque to providers. */
#define CMPI_THREAD_RETURN void*
#define CMPI_THREAD_TYPE void*
#define CMPI_MUTEX_TYPE void*
#define CMPI_COND_TYPE void*
/* Four bytes, as object managers in the field have it: createThreadKey writes through a pointer of this type. */
#define CMPI_THREAD_KEY_TYPE unsigned int
/* Calling convention of thread functions; Linux has only one. */
#define CMPI_THREAD_CDECL

/* Keep a symbol visible in a library that is built with hidden visibility. */
#if defined(__GNUC__) && __GNUC__ >= 4
#define CMPI_EXPORT __attribute__((visibility("default")))
#else
#define CMPI_EXPORT
#endif
#define CMPI_IMPORT CMPI_EXPORT

/* Declares a provider's factory function: C linkage, visible. */
#ifdef __cplusplus
#define CMPI_EXTERN_C extern "C" CMPI_EXPORT
#else
#define CMPI_EXTERN_C CMPI_EXPORT
#endif

#endif
