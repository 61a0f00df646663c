#include "AbiChecks.h"

#include <type_traits>

// These compare the types themselves: types that differ may have the same size.
#define SAME(name, ...) static_assert(std::is_same<name, __VA_ARGS__>::value, #name);
#include "TypeNames.inc"

// Statuses and data travel as plain C structures; a constructor would change how they are passed.
static_assert(std::is_trivial<CMPIStatus>::value && std::is_standard_layout<CMPIStatus>::value, "CMPIStatus");
static_assert(std::is_trivial<CMPIData>::value && std::is_standard_layout<CMPIData>::value, "CMPIData");
static_assert(std::is_trivial<CMPIValue>::value, "CMPIValue");

// Tables that a broker fills in C++ must be assignable, version included.
static_assert(std::is_copy_assignable<CMPIBrokerMemFT>::value, "CMPIBrokerMemFT");
static_assert(std::is_copy_assignable<CMPISelectCondFT>::value, "CMPISelectCondFT");
static_assert(std::is_copy_assignable<CMPIAssociationMIFT>::value, "CMPIAssociationMIFT");
