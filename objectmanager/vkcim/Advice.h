#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <string>
#include <vector>

/// What may help somebody who mistyped a name: lines for standard error. A provider may be asked anything, so none of
/// them keeps a request from it.
namespace vkcim {

/// Before a request is asked: properties, methods and arguments that its class lacks, and properties that it does not
/// let be changed.
std::vector<std::string> remarksOn(const om::Request& request, const om::Schema& schema);

/// That a class of the schema lacks a property, and the nearest one; empty where it has it, and for an unknown class.
std::string remarkOnProperty(const std::string& className, const std::string& property, const om::Schema& schema);

/// After the provider answered `status`, another one than OK: the classes, methods or arguments that there are.
std::vector<std::string> adviceOn(const om::Request& request, int status, const om::Schema& schema);

} // namespace vkcim
