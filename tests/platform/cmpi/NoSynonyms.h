/* Without synonyms the short names of type codes are free for others. */
#define CMPI_NO_SYNONYM_SUPPORT
#include "cmpidt.h"

#if defined(CMPI_Byte) || defined(CMPI_Short) || defined(CMPI_Int) || defined(CMPI_Long) || defined(CMPI_Float) ||     \
    defined(CMPI_Double) || defined(CMPI_ByteA) || defined(CMPI_ShortA) || defined(CMPI_IntA) ||                       \
    defined(CMPI_LongA) || defined(CMPI_FloatA) || defined(CMPI_DoubleA)
#error "synonyms must be off"
#endif
#ifndef CMPI_sint8A
#error "type codes must be on"
#endif
