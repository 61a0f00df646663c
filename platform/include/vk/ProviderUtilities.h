#pragma once

#include "vk/ClassId.h"
#include "vk/Moniker.h"

#include <cmpidt.h>
#include <cmpift.h>

#include <string>
#include <vector>

namespace VK {

/// What a provider does with CMPI objects, on top of any broker.
///
/// Every status and null that the broker returns is checked. A key or property that the broker refuses is left out
/// and logged once, at level 6000, and so is a path or an instance that it does not make. Paths, instances and arrays
/// belong to the broker and are never freed here. Nothing is thrown but std::bad_alloc, and std::runtime_error where
/// said: a request whose keys cannot be read must not be taken for one without them, which means all. A null path,
/// instance or argument list has no keys, properties or arguments.
class ProviderUtilities {
public:
    /// The class identifier of names that the class table does not hold.
    static constexpr unsigned short CLASS_ID_UNKNOWN = static_cast<unsigned short>(ClassId::Unknown);

    /// The identifier of a path's class, or 255. Class names compare without regard to case.
    static unsigned short getClassId(const CMPIObjectPath* objectPath);
    /// The same for a bare class name; 255 for null.
    static unsigned short getClassId(const char* className);

    /// Whether the two classes lie on one line of inheritance in that namespace, by the broker's schema (asked in both
    /// directions). False for null or empty names and for classes that the schema lacks.
    static bool areClassesRelated(const CMPIBroker* broker, const std::string& nameSpace, const char* className,
                                  const char* otherClassName);

    /// A path's namespace; empty when it has none. Throws std::runtime_error when the broker returns an error.
    static std::string getNamespace(const CMPIObjectPath* objectPath);

    /// A new path without keys, or null.
    static CMPIObjectPath* createObjectPath(const CMPIBroker* broker, const char* className, std::string nameSpace);

    /// How many keys the path has; 0 for a class path. Throws std::runtime_error when the broker returns an error, or
    /// cannot be asked.
    static unsigned int getKeyCount(const CMPIObjectPath* objectPath);

    /// Reads a text or a reference key, its name without regard to case: true and the value, or false (no such key, of
    /// another type, or null) with `value` untouched. Throws std::runtime_error when the broker offers no
    /// way of asking, or every way that it offers returns another error than that the key is missing.
    static bool getKeyProperty(const CMPIObjectPath* objectPath, const char* name, std::string& value);
    static bool getKeyProperty(const CMPIObjectPath* objectPath, const char* name, CMPIObjectPath** value);

    /// Adds a text or a reference key; false when the broker refuses it or the reference is null.
    static bool setKeyProperty(CMPIObjectPath* objectPath, const char* name, const std::string& value);
    static bool setKeyProperty(CMPIObjectPath* objectPath, const char* name, CMPIObjectPath* value);

    /// Appends the path's keys to the moniker, in order: text as it is, integers in decimal, booleans as `TRUE` and
    /// `FALSE`; references, nulls and other kinds are left out. False when the broker did not return the keys.
    static bool transformObjectPathToMoniker(const CMPIObjectPath* objectPath, Moniker& moniker);
    /// Adds the moniker's pairs to the path as text keys, in order; false when one was refused. The moniker's cursor
    /// stands on its first pair then; in a moniker without pairs it stays where it was.
    static bool transformMonikerToObjectPath(Moniker& moniker, CMPIObjectPath** objectPath);

    /// A new instance of that path, or null; null for a null path, too.
    static CMPIInstance* createInstance(const CMPIBroker* broker, CMPIObjectPath* objectPath);

    /// Sets a property of the CIM type that the value's type stands for; false when the broker refuses it.
    static bool setProperty(CMPIInstance* instance, const char* name, std::string& value);
    static bool setProperty(CMPIInstance* instance, const char* name, bool value);
    static bool setProperty(CMPIInstance* instance, const char* name, float value);
    static bool setProperty(CMPIInstance* instance, const char* name, unsigned int value);
    static bool setProperty(CMPIInstance* instance, const char* name, unsigned short value);
    static bool setProperty(CMPIInstance* instance, const char* name, CMPIObjectPath* value);
    /// Pointers that would silently become `bool`.
    static bool setProperty(CMPIInstance* instance, const char* name, const char* value) = delete;
    static bool setProperty(CMPIInstance* instance, const char* name, const CMPIObjectPath* value) = delete;

    /// Sets a text property or, with `dateTime`, a datetime property from a text in CIM form. A text that the broker
    /// does not take for a date-time leaves the property unset.
    static bool setProperty(const CMPIBroker* broker, CMPIInstance* instance, const char* name, std::string& value,
                            bool dateTime);
    /// Sets an array property; an empty vector sets an empty array.
    static bool setProperty(const CMPIBroker* broker, CMPIInstance* instance, const char* name,
                            std::vector<std::string>& values);
    static bool setProperty(const CMPIBroker* broker, CMPIInstance* instance, const char* name,
                            std::vector<unsigned short>& values);

    /// Reads a property or an argument of exactly that type: true and the value, or false (absent, null, of another
    /// type) with `value` untouched.
    static bool getProperty(const CMPIInstance* instance, const char* name, bool& value);
    static bool getProperty(const CMPIInstance* instance, const char* name, unsigned short& value);
    static bool getProperty(const CMPIArgs* arguments, const char* name, bool& value);
    static bool getProperty(const CMPIArgs* arguments, const char* name, unsigned int& value);

    /// Whether this host is a KVM virtual machine, by CPUID or the firmware's system names. Read once per process.
    static bool isKVM();
};

} // namespace VK
