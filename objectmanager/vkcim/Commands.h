#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <optional>

namespace vkcim {

enum class Action { Report, Operate, Classes, Describe, Value, Help };

/// What stands after a command's name.
enum class Takes { Nothing, Class, Path, Query, Command };

struct Command {
    const char* name;
    Action action;
    std::optional<om::Operation> operation; ///< for Operate alone
    Takes takes;
    const char* member; ///< `METHOD` or `PROPERTY` where one's name follows the path, else null
    bool assignments;   ///< NAME=VALUE… may follow
    bool needsAssignments;
    const char* about;
    const char* example;
    const char* warning = ""; ///< what the command changes, for its help
};

inline const Command commands[] = {
    {"report",
     Action::Report,
     {},
     Takes::Nothing,
     nullptr,
     false,
     false,
     "show everything that the provider knows about this host",
     "vkcim report"},
    {"classes",
     Action::Classes,
     {},
     Takes::Nothing,
     nullptr,
     false,
     false,
     "list the classes, each with its kind and superclass",
     "vkcim classes"},
    {"describe",
     Action::Describe,
     {},
     Takes::Class,
     nullptr,
     false,
     false,
     "show what a class has, and where on the host that comes from",
     "vkcim describe VESKA_TimeService"},
    {"value",
     Action::Value,
     {},
     Takes::Path,
     "PROPERTY",
     false,
     false,
     "print a property's bare value, one a line, for scripts",
     "vkcim value VESKA_PhysicalPackage SerialNumber"},
    {"names", Action::Operate, om::Operation::EnumInstanceNames, Takes::Class, nullptr, false, false,
     "list the paths of a class's instances", "vkcim names VESKA_ComputerSystem"},
    {"instances", Action::Operate, om::Operation::EnumInstances, Takes::Class, nullptr, false, false,
     "show all instances of a class", "vkcim --format json instances VESKA_ComputerSystem"},
    {"get", Action::Operate, om::Operation::GetInstance, Takes::Path, nullptr, false, false,
     "show the instance at a path", "vkcim names VESKA_ComputerSystem | vkcim get -"},
    {"modify", Action::Operate, om::Operation::ModifyInstance, Takes::Path, nullptr, true, true,
     "set properties of the instance at a path", "vkcim modify VESKA_TimeService AutomaticDSTAdjustment=true",
     "AutomaticDSTAdjustment=false replaces /etc/localtime by a zone without daylight saving time and remembers the "
     "zone that was there; AutomaticDSTAdjustment=true brings that one back. --dry-run shows what would be asked."},
    {"create", Action::Operate, om::Operation::CreateInstance, Takes::Path, nullptr, true, true, "create an instance",
     "vkcim create VESKA_ComputerSystem Name=node8 OperationalStatus=uint16[]:2"},
    {"delete", Action::Operate, om::Operation::DeleteInstance, Takes::Path, nullptr, false, false,
     "delete the instance at a path", "vkcim delete 'VESKA_ComputerSystem.Name=\"node8\"'"},
    {"query", Action::Operate, om::Operation::ExecQuery, Takes::Query, nullptr, false, false, "run a WQL query",
     "vkcim query 'SELECT * FROM VESKA_ComputerSystem'"},
    {"associators", Action::Operate, om::Operation::Associators, Takes::Path, nullptr, false, false,
     "show the instances associated with a path",
     "vkcim associators 'VESKA_ComputerSystem.Name=\"node7\"' --assoc-class VESKA_ComputerSystemPackage"},
    {"associator-names", Action::Operate, om::Operation::AssociatorNames, Takes::Path, nullptr, false, false,
     "list the paths associated with a path",
     "vkcim associator-names VESKA_ComputerSystem --assoc-class VESKA_ComputerCapabilities"},
    {"references", Action::Operate, om::Operation::References, Takes::Path, nullptr, false, false,
     "show the associations that refer to a path",
     "vkcim references VESKA_ComputerSystem --result-class VESKA_ComputerSystemPackage"},
    {"reference-names", Action::Operate, om::Operation::ReferenceNames, Takes::Path, nullptr, false, false,
     "list the paths of the associations that refer to a path",
     "vkcim reference-names VESKA_ComputerSystem --result-class VESKA_ComputerSystemPackage"},
    {"invoke", Action::Operate, om::Operation::InvokeMethod, Takes::Path, "METHOD", true, false, "call a method",
     "vkcim invoke VESKA_TimeService ManageTime GetRequest=true ManagedElement=VESKA_ComputerSystem",
     "ManageTime with GetRequest=false sets the clock and the time zone; SetCIMconfig changes settings of the CIM "
     "server. --dry-run shows what would be asked."},
    {"help",
     Action::Help,
     {},
     Takes::Command,
     nullptr,
     false,
     false,
     "show this, or the help on a command",
     "vkcim help modify"},
};

} // namespace vkcim
