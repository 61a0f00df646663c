#pragma once

#include "cmpi/PropertyTable.h"
#include "include/Trace.h"
#include "vk/ProviderUtilities.h"

#include <string>
#include <utility>

namespace VK::BaseServerProvider {

/// A key of an adapter's paths and where its text comes from. A key that the getter does not supply is left out.
template <class Data>
struct Key {
    const char* name;
    bool (Data::*getter)(std::string&) const;
};

/// A key that a request's path may bring: the name it is traced under, and the filter that it sets.
template <class Data>
struct KeyFilter {
    const char* key;
    const char* tracedAs;
    typename Data::FilterType filter;
};

/// The pattern of every adapter of an instance class: owns one data object and turns the element it stands on into a
/// path or an instance. The paths and instances belong to the broker.
///
/// `Self` says its class (`className`), its tables (`keys`, `keyFilters`, `properties`), whose trace lines it writes
/// (`traceSource()`), and its own name for the lines of constructor and destructor (`adapterName`, `destructorName`).
template <class Self, class Data>
class InstanceAdapter {
public:
    /// For the elements that the path names; all of the class when it has no keys.
    InstanceAdapter(const CMPIBroker* theBroker, const CMPIContext* theContext, const CMPIObjectPath* objectPath)
        : InstanceAdapter(theBroker, theContext, objectPath,
                          ParameterTraceScope(VK_SCOPE_OF(Self::traceSource(), Self::adapterName), " _broker=",
                                              theBroker, " _context=", theContext, " objectPath=", objectPath)) {}

    /// For all elements, to walk one end of an association.
    InstanceAdapter(const CMPIBroker* theBroker, const CMPIContext* theContext, std::string theNameSpace)
        : broker(theBroker), context(theContext), nameSpace(std::move(theNameSpace)) {
        traceMethod(VK_METHOD_OF(Self::traceSource(), Self::adapterName));
    }

    InstanceAdapter(const InstanceAdapter&) = delete;
    InstanceAdapter& operator=(const InstanceAdapter&) = delete;

    /// Narrows the walk by the keys of a request's path. A path without keys, or without those that filter, leaves it
    /// as it is, on purpose; the class name among the keys is not checked.
    void setObjectPath(const CMPIObjectPath* objectPath) {
        const ParameterTraceScope scope(VK_SCOPE(Self::traceSource()), " objectPath=", objectPath);
        if (ProviderUtilities::getKeyCount(objectPath) == 0) return;
        for (const KeyFilter<Data>& filter : Self::keyFilters) {
            std::string value;
            if (!ProviderUtilities::getKeyProperty(objectPath, filter.key, value)) continue;
            traceVariable(Self::traceSource(), filter.tracedAs, value.c_str());
            data.setFilter(filter.filter, value);
        }
    }

    /// Whether the adapter stands on an element.
    explicit operator bool() const {
        const TraceScope scope(VK_SCOPE(Self::traceSource()));
        return static_cast<bool>(data);
    }

    /// Moves to the next element.
    InstanceAdapter& operator++() {
        const TraceScope scope(VK_SCOPE(Self::traceSource()));
        ++data;
        return *this;
    }

    /// The current element's path, with every key that has a value; null when the broker could not make it whole.
    CMPIObjectPath* getObjectPath() const {
        const TraceScope scope(VK_SCOPE(Self::traceSource()));
        CMPIObjectPath* path = ProviderUtilities::createObjectPath(broker, Self::className, nameSpace);
        if (path == nullptr) return nullptr;
        for (const Key<Data>& key : Self::keys) {
            std::string value;
            if ((data.*key.getter)(value) && !ProviderUtilities::setKeyProperty(path, key.name, value)) return nullptr;
        }
        return path;
    }

    /// The current element's instance, with every property that has a value: the list is traced, and not applied, on
    /// purpose. Null when the broker could not make it.
    CMPIInstance* getCMPIInstance(const char** properties) const {
        const ParameterTraceScope scope(VK_SCOPE(Self::traceSource()), " properties=", properties);
        CMPIObjectPath* path = getObjectPath();
        // None of a null path either.
        CMPIInstance* instance = ProviderUtilities::createInstance(broker, path);
        if (instance == nullptr) return nullptr;
        for (const Property<Data>& property : Self::properties) publish(broker, instance, data, property);
        return instance;
    }

protected:
    ~InstanceAdapter() noexcept(false) { traceDestructor(VK_METHOD_OF(Self::traceSource(), Self::destructorName)); }

    const CMPIBroker* const broker;
    const CMPIContext* const context;
    const std::string nameSpace;
    Data data;

private:
    /// The scope is that of the whole constructor: its entry line stands before those of the members.
    InstanceAdapter(const CMPIBroker* theBroker, const CMPIContext* theContext, const CMPIObjectPath* objectPath,
                    const ParameterTraceScope&)
        : broker(theBroker), context(theContext), nameSpace(ProviderUtilities::getNamespace(objectPath)) {
        setObjectPath(objectPath);
    }
};

} // namespace VK::BaseServerProvider
