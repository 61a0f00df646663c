// The same provider in C++: the stubs' symbols and tables are no different.
#include "ProbeProvider.c"
