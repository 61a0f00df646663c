#pragma once

#include "cmpi/CMPIComputerSystem.h"
#include "include/Exceptions.h"
#include "include/Trace.h"
#include "vk/ClassId.h"
#include "vk/Moniker.h"
#include "vk/ProviderUtilities.h"

#include <string>

namespace VK::BaseServerProvider {

/// The pattern of every association adapter: one end is a computer system, the other a `Partner`. Built for one
/// request's path, which names either end or the association itself, it walks the elements at the other end, or the
/// associations. `Ends` is the data class that knows one end from the other.
///
/// `Self` says its class (`className`), the identifiers of the association and of the partner's class
/// (`associationClassId`, `partnerClassId`), the reference names (`computerRole`, `partnerRole`, and in the order in
/// which they are set `roles`), whether there is a pair to make a path of (`hasPair()`) and whose trace lines it writes
/// (`traceSource()`).
template <class Self, class Partner, class Ends>
class AssociationAdapter {
public:
    AssociationAdapter(const AssociationAdapter&) = delete;
    AssociationAdapter& operator=(const AssociationAdapter&) = delete;

    /// The path of the association that stands now, with both references; null when none does, when a path was refused,
    /// and when the broker did not return the class of the request's path, whose keys then have chosen nothing.
    CMPIObjectPath* getObjectPath() const {
        const TraceScope scope(VK_SCOPE(Self::traceSource()));
        if (requestedClassId == ClassId::Unknown) return nullptr;
        if (!static_cast<const Self&>(*this).hasPair()) return nullptr;
        CMPIObjectPath* path = keylessPath(Self::className);
        if (path == nullptr) return nullptr; // what was refused is logged
        for (const char* role : Self::roles) {
            CMPIObjectPath* const end = role == Self::computerRole ? computer.getObjectPath() : partner.getObjectPath();
            if (end == nullptr || !ProviderUtilities::setKeyProperty(path, role, end)) return nullptr;
        }
        return path;
    }

    /// The association's instance: its references as properties, and what `Self` adds. The list is traced, and not
    /// applied. Null when the broker could not make it.
    CMPIInstance* getCMPIInstance(const char** properties) {
        const ParameterTraceScope scope(VK_SCOPE(Self::traceSource()), " properties=", properties);
        CMPIObjectPath* path = getObjectPath();
        // None of a null path either.
        CMPIInstance* instance = ProviderUtilities::createInstance(broker, path);
        if (instance == nullptr) return nullptr;
        for (const char* role : Self::roles) {
            CMPIObjectPath* reference = nullptr;
            if (ProviderUtilities::getKeyProperty(path, role, &reference))
                ProviderUtilities::setProperty(instance, role, reference);
        }
        static_cast<Self&>(*this).addProperties(instance);
        return instance;
    }

    /// The path or instance of the element at the other end from the request's; null when the request came from
    /// neither end.
    CMPIObjectPath* getAssociatorNames() const {
        const TraceScope scope(VK_SCOPE(Self::traceSource()));
        if (requestedClassId == ClassId::ComputerSystem) return partner.getObjectPath();
        if (requestedClassId == Self::partnerClassId) return computer.getObjectPath();
        return nullptr;
    }
    CMPIInstance* getAssociator(const char** properties) const {
        const ParameterTraceScope scope(VK_SCOPE(Self::traceSource()), " properties=", properties);
        if (requestedClassId == ClassId::ComputerSystem) return partner.getCMPIInstance(properties);
        if (requestedClassId == Self::partnerClassId) return computer.getCMPIInstance(properties);
        return nullptr;
    }

protected:
    AssociationAdapter(const CMPIBroker* theBroker, const CMPIContext* context, const CMPIObjectPath* objectPath)
        : broker(theBroker), nameSpace(ProviderUtilities::getNamespace(objectPath)),
          requestedClassId(ClassId(ProviderUtilities::getClassId(objectPath))), partner(theBroker, context, nameSpace),
          computer(theBroker, context, nameSpace) {}
    ~AssociationAdapter() = default;

    /// A new path of `className` without keys; null when the broker makes none.
    CMPIObjectPath* keylessPath(const char* className) const {
        return ProviderUtilities::createObjectPath(broker, className, nameSpace);
    }

    /// A new path of `className`: keyless for a keyless path, else with the keys into which `resolve` turns those of
    /// `objectPath`. Null for null, and when the broker refuses the path or one of its keys, which is logged, or drops
    /// an empty one: without its keys it would name every element. What `resolve` throws passes. Where the broker
    /// does not return the keys, this throws InstrumentationException.
    template <class Resolve>
    CMPIObjectPath* locate(const char* className, const CMPIObjectPath* objectPath, Resolve resolve) const {
        if (objectPath == nullptr) return nullptr;
        CMPIObjectPath* path = keylessPath(className);
        if (path == nullptr || ProviderUtilities::getKeyCount(objectPath) == 0) return path;
        Moniker moniker;
        const bool read = ProviderUtilities::transformObjectPathToMoniker(objectPath, moniker);
        resolve(moniker);
        if (!read) throw InstrumentationException("Could not make the path of the other end");
        const bool whole = ProviderUtilities::transformMonikerToObjectPath(moniker, &path) && hasKey(path, moniker);
        return whole ? path : nullptr;
    }

    /// Narrows the walk of an end by a path. False for null, a path that was refused: there is nothing to walk then,
    /// while an end that is not narrowed would go over all elements.
    template <class End>
    static bool narrow(End& end, const CMPIObjectPath* path) {
        if (path != nullptr) end.setObjectPath(path);
        return path != nullptr;
    }

    /// Traces what the request's path names.
    void traceRequestedClassId(const TracePoint& at) const {
        traceVariable(at, "requestedClassId", static_cast<unsigned int>(requestedClassId));
    }

    void addProperties(CMPIInstance*) const {}

    const CMPIBroker* const broker;
    const std::string nameSpace;
    const ClassId requestedClassId;
    Ends ends;
    Partner partner;
    CMPIComputerSystem computer;

private:
    /// Whether the path has the one key that its moniker has. Some object managers take an empty string for a missing
    /// key and drop it without an error.
    static bool hasKey(const CMPIObjectPath* path, const Moniker& moniker) {
        std::string name;
        std::string value;
        moniker.getName(name);
        moniker.getValue(value);
        return !value.empty() || ProviderUtilities::getKeyProperty(path, name.c_str(), value);
    }
};

} // namespace VK::BaseServerProvider
