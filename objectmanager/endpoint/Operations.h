#pragma once

#include "objectmanager/cimxml/Request.h"
#include "objectmanager/endpoint/Contexts.h"
#include "objectmanager/endpoint/NameSpace.h"

#include <string>
#include <vector>

namespace endpoint {

/// What a request was answered.
struct Outcome {
    std::string message; ///< the whole document
    int code = 0;        ///< its CIM status
};

/// Whether only who may change something may ask for it.
bool changesSomething(const cimxml::Request& request);

/// The CIM operations over namespaces: a request in, an answer out. May be called from several threads at once.
class Operations {
public:
    /// `host` stands in the paths of answers.
    Operations(std::vector<NameSpace> spaces, std::string host);

    Outcome answer(const cimxml::Request& request, const Caller& caller);

private:
    std::string content(const cimxml::Request& request, const Caller& caller);

    std::vector<NameSpace> nameSpaces;
    std::string hostName;
    Contexts contexts;
};

/// What stands in an IMETHODRESPONSE for each operation. They throw CimError.
struct Call;
std::string getInstance(const Call& call);
std::string enumerateInstances(const Call& call);
std::string enumerateInstanceNames(const Call& call);
std::string createInstance(const Call& call);
std::string modifyInstance(const Call& call);
std::string deleteInstance(const Call& call);
std::string getProperty(const Call& call);
std::string setProperty(const Call& call);
std::string associators(const Call& call);
std::string associatorNames(const Call& call);
std::string references(const Call& call);
std::string referenceNames(const Call& call);
std::string getClass(const Call& call);
std::string enumerateClasses(const Call& call);
std::string enumerateClassNames(const Call& call);
std::string getQualifier(const Call& call);
std::string enumerateQualifiers(const Call& call);
std::string openEnumerateInstances(const Call& call);
std::string openEnumerateInstancePaths(const Call& call);
std::string openAssociatorInstances(const Call& call);
std::string openAssociatorInstancePaths(const Call& call);
std::string openReferenceInstances(const Call& call);
std::string openReferenceInstancePaths(const Call& call);
std::string pullInstancesWithPath(const Call& call);
std::string pullInstancePaths(const Call& call);
std::string closeEnumeration(const Call& call);
/// What stands in a METHODRESPONSE.
std::string invokeMethod(const Call& call);

} // namespace endpoint
