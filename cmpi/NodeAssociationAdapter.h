#pragma once

#include "cmpi/AssociationAdapter.h"

namespace VK::BaseServerProvider {

/// The association adapters whose ends are looked up in the node tree. The keys of an association's path are checked
/// against each other; without keys the walk goes over all computers, each with its own partners.
///
/// `Self` offers `locatePartner` and `locateComputer`.
template <class Self, class Partner, class Ends>
class NodeAssociationAdapter : public AssociationAdapter<Self, Partner, Ends> {
    using Base = AssociationAdapter<Self, Partner, Ends>;

public:
    /// Throws InstrumentationException "Could not find instance" for an association path that names none, and what the
    /// data class throws for an end that is not there.
    NodeAssociationAdapter(const CMPIBroker* theBroker, const CMPIContext* context, const CMPIObjectPath* objectPath)
        : NodeAssociationAdapter(theBroker, context, objectPath,
                                 ParameterTraceScope(VK_SCOPE_OF(Self::traceSource(), Self::adapterName), " _broker=",
                                                     theBroker, " _context=", context, " objectPath=", objectPath)) {}

    explicit operator bool() const {
        const TraceScope scope(VK_SCOPE(Self::traceSource()));
        return valid;
    }

    NodeAssociationAdapter& operator++() {
        const TraceScope scope(VK_SCOPE(Self::traceSource()));
        if (requestedClassId == ClassId::ComputerSystem) {
            ++partner;
            valid = static_cast<bool>(partner);
        } else if (requestedClassId == Self::partnerClassId) {
            ++computer;
            valid = static_cast<bool>(computer);
        } else if (requestedClassId == Self::associationClassId && !singleInstance) {
            ++partner;
            skipComputersWithoutPartner();
        } else {
            valid = false; // the one instance named is passed, or there was none to begin with
        }
        return *this;
    }

    /// Whether there is a pair: as operator bool, but writes no line.
    bool hasPair() const { return valid; }

    /// Moves to the association that the path names; for a path without keys, to the first of all. False when there
    /// is none: a reference is missing, they do not belong together, or there is no computer. Where the broker refused
    /// a path on the way, it returns true, and there is nothing to walk.
    bool setObjectPath(const CMPIObjectPath* objectPath) {
        const ParameterTraceScope scope(VK_SCOPE(Self::traceSource()), " objectPath=", objectPath);
        return ProviderUtilities::getKeyCount(objectPath) == 0 ? selectFirst() : selectNamed(objectPath);
    }

protected:
    ~NodeAssociationAdapter() noexcept(false) {
        traceDestructor(VK_METHOD_OF(Self::traceSource(), Self::destructorName));
    }

    using Base::computer;
    using Base::narrow;
    using Base::partner;
    using Base::requestedClassId;

private:
    /// The scope is that of the whole constructor: its entry line stands before those of the members.
    NodeAssociationAdapter(const CMPIBroker* theBroker, const CMPIContext* context, const CMPIObjectPath* objectPath,
                           const ParameterTraceScope&)
        : Base(theBroker, context, objectPath) {
        Base::traceRequestedClassId(TracePoint(Self::traceSource(), Self::adapterName));
        if (requestedClassId == ClassId::ComputerSystem) {
            valid = narrow(partner, self().locatePartner(objectPath)) && partner;
        } else if (requestedClassId == Self::partnerClassId) {
            valid = narrow(computer, self().locateComputer(objectPath)) && computer;
        } else if (requestedClassId == Self::associationClassId) {
            if (!setObjectPath(objectPath)) throw InstrumentationException("Could not find instance");
        }
        // On purpose: for any other class the adapter stands once, and returns null.
    }

    Self& self() { return static_cast<Self&>(*this); }

    bool selectFirst() {
        if (!computer) return false;
        skipComputersWithoutPartner(narrow(partner, self().locatePartner(computer.getObjectPath())));
        return true;
    }

    bool selectNamed(const CMPIObjectPath* objectPath) {
        singleInstance = true;
        CMPIObjectPath* partnerPath = nullptr;
        if (!ProviderUtilities::getKeyProperty(objectPath, Self::partnerRole, &partnerPath)) return false;
        partner.setObjectPath(partnerPath);
        CMPIObjectPath* const located = self().locateComputer(partnerPath);
        if (located == nullptr) {
            valid = false;
            return true;
        }
        CMPIObjectPath* computerPath = nullptr;
        std::string name;
        std::string locatedName;
        if (!ProviderUtilities::getKeyProperty(objectPath, Self::computerRole, &computerPath) ||
            !ProviderUtilities::getKeyProperty(computerPath, "Name", name) ||
            !ProviderUtilities::getKeyProperty(located, "Name", locatedName) || name != locatedName)
            return false;
        computer.setObjectPath(located);
        valid = computer && partner;
        return true;
    }

    /// Moves on to the next computer that has a partner, unless the current one has. Each computer's partners are a
    /// walk of their own. `narrowed` is whether the current one's could be looked for: a computer whose path the broker
    /// refused is passed over.
    void skipComputersWithoutPartner(bool narrowed = true) {
        while (!(narrowed && partner) && computer) {
            ++computer;
            if (!computer) break;
            partner.initialize();
            narrowed = narrow(partner, self().locatePartner(computer.getObjectPath()));
        }
        valid = narrowed && partner;
    }

    bool singleInstance = false;
    bool valid = true;
};

} // namespace VK::BaseServerProvider
