#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <optional>

namespace vkcim {

/// What stands after a command's name.
enum class Takes { Nothing, Class, Path, Query };

struct Command {
    const char* name;
    std::optional<om::Operation> operation; ///< none: `report`
    Takes takes;
    bool method;      ///< a method's name follows the path
    bool assignments; ///< NAME=VALUE… may follow
    bool needsAssignments;
    const char* about;
    const char* example;
};

inline const Command commands[] = {
    {"report",
     {},
     Takes::Nothing,
     false,
     false,
     false,
     "show everything that the provider knows about this host",
     "vkcim report"},
    {"names", om::Operation::EnumInstanceNames, Takes::Class, false, false, false,
     "list the paths of a class's instances", "vkcim names VESKA_ComputerSystem"},
    {"instances", om::Operation::EnumInstances, Takes::Class, false, false, false, "show all instances of a class",
     "vkcim --format json instances VESKA_ComputerSystem"},
    {"get", om::Operation::GetInstance, Takes::Path, false, false, false, "show the instance at a path",
     "vkcim names VESKA_ComputerSystem | vkcim get -"},
    {"modify", om::Operation::ModifyInstance, Takes::Path, false, true, true,
     "set properties of the instance at a path", "vkcim modify VESKA_TimeService AutomaticDSTAdjustment=true"},
    {"create", om::Operation::CreateInstance, Takes::Path, false, true, true, "create an instance",
     "vkcim create VESKA_ComputerSystem Name=node8 OperationalStatus=uint16[]:2"},
    {"delete", om::Operation::DeleteInstance, Takes::Path, false, false, false, "delete the instance at a path",
     "vkcim delete 'VESKA_ComputerSystem.Name=\"node8\"'"},
    {"query", om::Operation::ExecQuery, Takes::Query, false, false, false, "run a WQL query",
     "vkcim query 'SELECT * FROM VESKA_ComputerSystem'"},
    {"associators", om::Operation::Associators, Takes::Path, false, false, false,
     "show the instances associated with a path",
     "vkcim associators 'VESKA_ComputerSystem.Name=\"node7\"' --assoc-class VESKA_ComputerSystemPackage"},
    {"associator-names", om::Operation::AssociatorNames, Takes::Path, false, false, false,
     "list the paths associated with a path",
     "vkcim associator-names VESKA_ComputerSystem --assoc-class VESKA_ComputerCapabilities"},
    {"references", om::Operation::References, Takes::Path, false, false, false,
     "show the associations that refer to a path",
     "vkcim references VESKA_ComputerSystem --result-class VESKA_ComputerSystemPackage"},
    {"reference-names", om::Operation::ReferenceNames, Takes::Path, false, false, false,
     "list the paths of the associations that refer to a path",
     "vkcim reference-names VESKA_ComputerSystem --result-class VESKA_ComputerSystemPackage"},
    {"invoke", om::Operation::InvokeMethod, Takes::Path, true, true, false, "call a method",
     "vkcim invoke VESKA_TimeService ManageTime GetRequest=true ManagedElement=VESKA_ComputerSystem"},
};

} // namespace vkcim
