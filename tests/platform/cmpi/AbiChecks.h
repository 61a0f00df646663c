/*
 * The binary interface as static assertions, in C and in C++: it compiles exactly where every size, offset and number
 * is as the tables say.
 */
#include "Layout.h"
#include "cmpift.h"

#include <stddef.h>

#ifdef __cplusplus
#define CHECK static_assert
#define ALIGNMENT alignof
#else
#define CHECK _Static_assert
#define ALIGNMENT _Alignof
#endif

#define TYPE(type, size) CHECK(sizeof(type) == size, #type);
#define STRUCT(type, size, alignment) CHECK(sizeof(type) == size && ALIGNMENT(type) == alignment, #type);
#define FIELD(type, member, offset, size)                                                                              \
    CHECK(offsetof(type, member) == offset && sizeof(((type*)0)->member) == size, #type "." #member);
#include "LayoutOfBroker.inc"
#include "LayoutOfData.inc"
#include "LayoutOfObjects.inc"
#include "LayoutOfProviders.inc"

#define VALUE(name, number) CHECK(name == number, #name);
#define TEXT(name, text) CHECK(sizeof(name) == sizeof(text), #name);
#include "Constants.inc"
#include "ErrorConstants.inc"

/* Type codes work in the preprocessor too. */
#if CMPI_stringA != (CMPI_ARRAY | CMPI_string) || CMPI_IntA != CMPI_sint32A
#error "type codes must be plain numbers"
#endif
