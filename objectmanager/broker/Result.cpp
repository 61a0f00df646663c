#include "objectmanager/broker/Result.h"

#include "objectmanager/broker/Convert.h"
#include "objectmanager/broker/Error.h"
#include "objectmanager/broker/Instance.h"
#include "objectmanager/broker/ObjectPath.h"

namespace om {

namespace {

ResultObject& openUnclosed(const CMPIResult* handle) {
    auto& self = open<ResultObject>(handle);
    if (self.answer->done) throw Failure{CMPI_RC_ERR_FAILED};
    return self;
}

bool takesPaths(Operation operation) {
    return operation == Operation::EnumInstanceNames || operation == Operation::CreateInstance ||
           operation == Operation::AssociatorNames || operation == Operation::ReferenceNames;
}

bool takesInstances(Operation operation) {
    return operation == Operation::EnumInstances || operation == Operation::GetInstance ||
           operation == Operation::ExecQuery || operation == Operation::Associators ||
           operation == Operation::References;
}

/// A method returns one value. Values of object types come through the functions for objects as well.
void returnValue(ResultObject& self, Value value) {
    if (self.answer->returnValue) throw Failure{CMPI_RC_ERR_FAILED};
    self.answer->returnValue = std::move(value);
}

void returnPath(ResultObject& self, const ObjectPath& path) {
    if (self.operation == Operation::InvokeMethod) {
        returnValue(self, {CMPI_ref, std::make_shared<const ObjectPath>(path)});
    } else if (takesPaths(self.operation)) {
        self.answer->results.emplace_back(path);
    } else {
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    }
}

void returnWhole(ResultObject& self, Instance instance) {
    if (self.operation == Operation::InvokeMethod) {
        returnValue(self, {CMPI_instance, std::make_shared<const Instance>(std::move(instance))});
    } else if (takesInstances(self.operation)) {
        self.answer->results.emplace_back(std::move(instance));
    } else {
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    }
}

CMPIStatus returnInstance(const CMPIResult* handle, const CMPIInstance* instance) {
    auto& self = openUnclosed(handle);
    returnWhole(self, open<InstanceObject>(instance).complete());
    return status(CMPI_RC_OK);
}

CMPIStatus returnObjectPath(const CMPIResult* handle, const CMPIObjectPath* path) {
    auto& self = openUnclosed(handle);
    returnPath(self, open<PathObject>(path).path);
    return status(CMPI_RC_OK);
}

CMPIStatus returnData(const CMPIResult* handle, const CMPIValue* value, CMPIType type) {
    auto& self = openUnclosed(handle);
    if (type == CMPI_null) throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    Value given = read(value, type);
    if (self.operation == Operation::InvokeMethod) {
        returnValue(self, std::move(given));
    } else if (given.isNull()) {
        throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    } else if (type == CMPI_ref) {
        returnPath(self, *std::get<std::shared_ptr<const ObjectPath>>(given.data));
    } else if (type == CMPI_instance) {
        returnWhole(self, *std::get<std::shared_ptr<const Instance>>(given.data));
    } else {
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    }
    return status(CMPI_RC_OK);
}

CMPIStatus returnDone(const CMPIResult* handle) {
    openUnclosed(handle).answer->done = true;
    return status(CMPI_RC_OK);
}

CMPIStatus returnError(const CMPIResult* handle, const CMPIError* error) {
    auto& self = openUnclosed(handle);
    const auto& given = open<ErrorObject>(error);
    if (!self.errorMessage) self.errorMessage = given.attributes.message;
    return status(CMPI_RC_OK);
}

// A result belongs to its call: there is nothing that a copy could be given to.
CMPIResult* clone(const CMPIResult* handle, CMPIStatus*) {
    open<ResultObject>(handle);
    throw Failure{CMPI_RC_ERR_NOT_SUPPORTED};
}

constexpr CMPIResultFT makeTable() {
    auto ft = emptyTable<CMPIResultFT>();
    ft.release = Slot<&releaseObject<ResultObject>, FaultKind::release>();
    ft.clone = Slot<&clone, FaultKind::clone>();
    ft.returnData = Slot<&returnData, FaultKind::returnData>();
    ft.returnInstance = Slot<&returnInstance, FaultKind::returnInstance>();
    ft.returnObjectPath = Slot<&returnObjectPath, FaultKind::returnObjectPath>();
    ft.returnDone = Slot<&returnDone, FaultKind::returnDone>();
    ft.returnError = Slot<&returnError, FaultKind::returnError>();
    return ft;
}

} // namespace

const CMPIResultFT ResultObject::table = makeTable();

} // namespace om
