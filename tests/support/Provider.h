#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <optional>
#include <string>
#include <utility>
#include <vector>

/// The provider's real library, asked through the embedded object manager.
namespace test {

/// The process's object manager with the provider loaded.
om::ObjectManager& provider();

/// A path in root/cimv2 with text keys.
om::ObjectPath path(const std::string& className, const std::vector<std::pair<std::string, std::string>>& keys = {});
/// A path with reference keys.
om::ObjectPath associationPath(const std::string& className,
                               const std::vector<std::pair<std::string, om::ObjectPath>>& references);

om::Answer names(const std::string& className);
om::Answer instances(const std::string& className);
om::Answer get(const om::ObjectPath& path);
om::Answer associatorNames(const om::ObjectPath& source, std::optional<std::string> assocClass,
                           std::optional<std::string> resultClass = {});
om::Answer associators(const om::ObjectPath& source, std::optional<std::string> assocClass,
                       std::optional<std::string> resultClass = {});
om::Answer modify(const om::ObjectPath& path, std::vector<om::NamedValue> properties);
om::Answer invoke(const om::ObjectPath& path, const std::string& method, std::vector<om::NamedValue> in);

/// The answer's results as they are; the test ends with an exception where they are of the other kind.
std::vector<om::ObjectPath> paths(const om::Answer& answer);
std::vector<om::Instance> instancesOf(const om::Answer& answer);

/// A key or property by name, null when it is not there; a text in it.
const om::Value* find(const std::vector<om::NamedValue>& values, const std::string& name);
std::string text(const om::Value& value);
/// The names in order.
std::vector<std::string> namesOf(const std::vector<om::NamedValue>& values);

/// One line for people: `Class.Key="value",…`.
std::string print(const om::ObjectPath& path);

} // namespace test
