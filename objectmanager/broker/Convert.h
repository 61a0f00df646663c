#pragma once

#include "objectmanager/broker/Object.h"

#include <memory>
#include <vector>

namespace om {

/// The type that a value is kept with: both kinds of plain text are kept as strings.
CMPIType storedType(CMPIType type);
/// Whether values of that type can be kept: scalars, strings, date-times, paths, instances, and arrays of these.
bool isValueType(CMPIType type);

/// The value that a provider passes: as many bytes as the type has are read, CMPI_chars being the text itself. A null
/// pointer, or a null object in the value, is a typed null. Throws Failure INVALID_DATA_TYPE for a type that no value
/// has, INVALID_HANDLE for an object that is not ours, TYPE_MISMATCH for an array of other elements.
Value read(const CMPIValue* value, CMPIType type);

/// The value as getters give it; objects in it are parts of `parent`.
CMPIData give(const Managed& parent, const Value& value, CMPIValueState state = CMPI_goodValue);

/// A CMPI object that shows a string, array, date-time, path or instance.
std::unique_ptr<Managed> wrap(Broker& broker, Value value);

/// The getters that lists of named values share. An absent name and an index out of range are NO_SUCH_PROPERTY.
CMPIData giveNamed(const Managed& parent, const std::vector<NamedValue>& list, const char* name, CMPIStatus* rc,
                   CMPIValueState state = CMPI_goodValue);
CMPIData giveAt(const Managed& parent, const std::vector<NamedValue>& list, CMPICount index, CMPIString** name,
                CMPIStatus* rc, CMPIValueState state = CMPI_goodValue);

} // namespace om
