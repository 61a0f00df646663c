#include "cmpi/CMPIComputerSystemPackage.h"
#include "cmpi/CMPIElementCapabilities.h"
#include "cmpi/CMPIServiceAffectsElement.h"
#include "provider/OperationFrame.h"
#include "vk/ClassId.h"
#include "vk/ProviderUtilities.h"

namespace VK::BaseServerProvider {
namespace {

struct Request {
    const CMPIContext* context;
    Answer& answer;
    const CMPIObjectPath* op;
    const char* assocClass;
    const char* resultClass;
    const char** properties;
};

/// Whether the request wants no class of the other end. Only the package association asks; role and result role are
/// ignored. Both are on purpose.
bool refuses(const CMPIComputerSystemPackage& adapter, const Request& request) {
    return request.resultClass != nullptr && *request.resultClass != '\0' &&
           adapter.isNotTargetClass(request.resultClass);
}
template <class Adapter>
bool refuses(const Adapter&, const Request&) {
    return false;
}

template <class Adapter, class Return>
void walk(const Request& request, Return returnCurrent) {
    Adapter adapter(broker, request.context, request.op);
    if (refuses(adapter, request)) return;
    for (; adapter; ++adapter) returnCurrent(adapter);
}

template <class Adapter>
void walkNames(const Request& request) {
    walk<Adapter>(request, [&](Adapter& adapter) { request.answer.add(adapter.getAssociatorNames()); });
}

template <class Adapter>
void walkInstances(const Request& request) {
    walk<Adapter>(request, [&](Adapter& adapter) { request.answer.add(adapter.getAssociator(request.properties)); });
}

struct AssociationRow {
    ClassId classId;
    const char* baseClass; ///< whose relatives count as this association
    void (*associatorNames)(const Request&);
    void (*associators)(const Request&);
};

template <class Adapter>
constexpr AssociationRow row(const char* baseClass) {
    return {Adapter::associationClassId, baseClass, walkNames<Adapter>, walkInstances<Adapter>};
}

// In the order in which a class is tested for being related.
constexpr AssociationRow associationRows[] = {
    row<CMPIElementCapabilities>("CIM_ElementCapabilities"),
    row<CMPIComputerSystemPackage>("CIM_ComputerSystemPackage"),
    row<CMPITimeServiceAffectsElement>("CIM_ServiceAffectsElement"),
};

/// The steps that both operations share; they differ in the column.
CMPIStatus serve(const OperationFrame& frame, void (*AssociationRow::*column)(const Request&), const Request& request) {
    return frame.runMarked([&](CMPIStatus& status) {
        traceVariable(frame.here(), "resultClass", request.resultClass);
        traceVariable(frame.here(), "associationClass", request.assocClass);
        const std::string nameSpace = ProviderUtilities::getNamespace(request.op);
        std::vector<unsigned short> ids;
        if (!getClassId(request.assocClass, nameSpace.c_str(), ids)) {
            traceVariable(frame.here(), "CMPI_RC_ERR_INVALID_CLASS", CMPI_RC_ERR_INVALID_CLASS);
            status.rc = CMPI_RC_ERR_INVALID_CLASS;
            return;
        }
        for (const unsigned short id : ids) {
            const AssociationRow* const associationRow = findRow(associationRows, id);
            if (associationRow != nullptr)
                (associationRow->*column)(request);
            else
                status.rc = CMPI_RC_ERR_INVALID_CLASS;
            const unsigned int served = associationRow != nullptr ? 1 : 0;
            traceVariable(frame.here(), "rcode", served);
            if (served == 0) {
                traceVariable(frame.here(), "rcode", served);
                return;
            }
        }
        request.answer.close();
    });
}

} // namespace

bool getClassId(const char* className, const char* nameSpace, std::vector<unsigned short>& ids) {
    if (className == nullptr || *className == '\0') { // no class in particular
        for (const AssociationRow& associationRow : associationRows)
            ids.push_back(static_cast<unsigned short>(associationRow.classId));
        return true;
    }
    const unsigned short classId = ProviderUtilities::getClassId(className);
    if (classId != ProviderUtilities::CLASS_ID_UNKNOWN) {
        ids.push_back(classId);
        return true;
    }
    bool related = false;
    for (const AssociationRow& associationRow : associationRows) {
        if (!ProviderUtilities::areClassesRelated(broker, nameSpace, className, associationRow.baseClass)) continue;
        ids.push_back(static_cast<unsigned short>(associationRow.classId));
        related = true;
    }
    return related;
}

CMPIStatus BaseServer_AssociatorNames(CMPIAssociationMI*, const CMPIContext* context, const CMPIResult* result,
                                      const CMPIObjectPath* op, const char* assocClass, const char* resultClass,
                                      const char*, const char*) {
    const OperationFrame frame(VK_PLACE());
    Answer answer(frame, result);
    return serve(frame, &AssociationRow::associatorNames, {context, answer, op, assocClass, resultClass, nullptr});
}

CMPIStatus BaseServer_Associators(CMPIAssociationMI*, const CMPIContext* context, const CMPIResult* result,
                                  const CMPIObjectPath* op, const char* assocClass, const char* resultClass,
                                  const char*, const char*, const char** properties) {
    const OperationFrame frame(VK_PLACE());
    Answer answer(frame, result);
    return serve(frame, &AssociationRow::associators, {context, answer, op, assocClass, resultClass, properties});
}

CMPIStatus BaseServer_References(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                 const char*, const char*, const char**) {
    return OperationFrame(VK_PLACE()).notSupported();
}

CMPIStatus BaseServer_ReferenceNames(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                     const char*, const char*) {
    return OperationFrame(VK_PLACE()).notSupported();
}

} // namespace VK::BaseServerProvider
