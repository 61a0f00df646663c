#include "AbiChecks.h"

/* These compare the types themselves: types that differ may have the same size. */
#define SAME(name, type) _Static_assert(_Generic((name*)0, type * : 1, default : 0), #name);
#include "TypeNames.inc"
