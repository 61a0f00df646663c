#include "AbiChecks.h"

/* Where sizes agree, these tell the types apart. */
#define SAME(name, type) _Static_assert(_Generic((name*)0, type * : 1, default : 0), #name);
#include "TypeNames.inc"
