#pragma once

#include "objectmanager/model/Schema.h"
#include "objectmanager/model/Values.h"
#include "objectmanager/vkcim/SourceText.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// Paths as texts: `root/cimv2:VESKA_ComputerSystem.Name="node7",Index=3,Active=TRUE`.
namespace vkcim {

/// Reads a path without host. A path that names no namespace, and each reference in it that names none, gets
/// `nameSpace` or that of the path around it. The schema says which quoted keys are references; for a class or key
/// that it lacks they are strings unless written `KEY=ref:"…"`. Integers are sint64, those above its range uint64.
/// Throws ParseError. What may be asked all the same goes to `remarks`, each with its place: keys that a class of the
/// schema lacks, or has with another type.
om::ObjectPath parsePath(std::string_view text, const std::string& nameSpace, const om::Schema& schema,
                         std::vector<std::string>* remarks = nullptr);
om::ObjectPath parsePath(const SourceText& text, const std::string& nameSpace, const om::Schema& schema,
                         std::vector<std::string>* remarks = nullptr);

/// Why no object can lie in a namespace of that name; nothing where one can.
std::optional<std::string> nameSpaceProblem(std::string_view name);

/// Class and keys, so that parsePath reads them back; references in the keys carry their namespace where it differs
/// from `nameSpace`. Keys of a type that no path can hold (reals, date-times) become quoted texts.
std::string pathText(const om::ObjectPath& path, const std::string& nameSpace, const om::Schema& schema);

/// pathText, with the path's own namespace before it where it differs from `nameSpace`.
std::string qualifiedPathText(const om::ObjectPath& path, const std::string& nameSpace, const om::Schema& schema);

} // namespace vkcim
