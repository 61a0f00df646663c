#pragma once

/* What a ProbeProvider library says about itself. */

#include <cmpift.h>

struct ProbeFacts {
    const CMPIBroker* broker;       /* as the factory stored it */
    const CMPIBroker* brokerInHook; /* what the instance stub's hook found stored */
    int hookSum;                    /* 3 once the property stub's hook has run */
    const char* called;             /* the function called last, */
    const void* arguments[9];       /* its arguments, */
    size_t count;                   /* and how many there were */
};

/* Exported by the library as probeFacts. */
typedef struct ProbeFacts* ProbeFactsFunction(void);
