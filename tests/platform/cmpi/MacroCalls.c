/* Every macro compiles in C without a warning, for a plain variable as value too. Nothing here runs. */
#include "Layout.h"
#include "cmpift.h"

void callEveryMacro(void);

#define ARGUMENT(type, name) static type name;
#include "MacroArguments.inc"

void callEveryMacro(void) {
#define CALL(table, slot, macro, ...) (void)macro(__VA_ARGS__);
#include "MacroCalls.inc"
}
