#pragma once

#include "objectmanager/cimxml/Pieces.h"
#include "objectmanager/cimxml/Request.h"
#include "objectmanager/endpoint/Contexts.h"
#include "objectmanager/endpoint/NameSpace.h"

#include <limits>
#include <string>
#include <vector>

namespace endpoint {

/// What a request was answered.
struct Outcome {
    std::string message; ///< the document, or its beginning
    cimxml::Pieces rest; ///< what follows, written when it is sent; may refer to the operations
    int code = 0;        ///< its CIM status
};

/// Whether only who may change something may ask for it.
bool changesSomething(const cimxml::Request& request);

/// The CIM operations over namespaces: a request in, an answer out. May be called from several threads at once.
class Operations {
public:
    /// `host` stands in the paths of answers.
    Operations(std::vector<NameSpace> spaces, std::string host);

    /// The providers have answered when this returns, and a document of up to `enough` bytes, or a little more, is
    /// whole.
    Outcome answer(const cimxml::Request& request, const Caller& caller,
                   std::size_t enough = std::numeric_limits<std::size_t>::max());

private:
    cimxml::Pieces content(const cimxml::Request& request, const Caller& caller);

    std::vector<NameSpace> nameSpaces;
    std::string hostName;
    Contexts contexts;
};

/// What stands in an IMETHODRESPONSE for each operation. They throw CimError.
struct Call;
cimxml::Pieces getInstance(const Call& call);
cimxml::Pieces enumerateInstances(const Call& call);
cimxml::Pieces enumerateInstanceNames(const Call& call);
cimxml::Pieces createInstance(const Call& call);
cimxml::Pieces modifyInstance(const Call& call);
cimxml::Pieces deleteInstance(const Call& call);
cimxml::Pieces getProperty(const Call& call);
cimxml::Pieces setProperty(const Call& call);
cimxml::Pieces associators(const Call& call);
cimxml::Pieces associatorNames(const Call& call);
cimxml::Pieces references(const Call& call);
cimxml::Pieces referenceNames(const Call& call);
cimxml::Pieces getClass(const Call& call);
cimxml::Pieces enumerateClasses(const Call& call);
cimxml::Pieces enumerateClassNames(const Call& call);
cimxml::Pieces getQualifier(const Call& call);
cimxml::Pieces enumerateQualifiers(const Call& call);
cimxml::Pieces openEnumerateInstances(const Call& call);
cimxml::Pieces openEnumerateInstancePaths(const Call& call);
cimxml::Pieces openAssociatorInstances(const Call& call);
cimxml::Pieces openAssociatorInstancePaths(const Call& call);
cimxml::Pieces openReferenceInstances(const Call& call);
cimxml::Pieces openReferenceInstancePaths(const Call& call);
cimxml::Pieces pullInstancesWithPath(const Call& call);
cimxml::Pieces pullInstancePaths(const Call& call);
cimxml::Pieces closeEnumeration(const Call& call);
/// What stands in a METHODRESPONSE.
cimxml::Pieces invokeMethod(const Call& call);

} // namespace endpoint
