#pragma once

#include "objectmanager/cimxml/Errors.h"
#include "objectmanager/cimxml/Pieces.h"
#include "objectmanager/cimxml/Typing.h"
#include "objectmanager/cimxml/Writer.h"
#include "objectmanager/endpoint/NameSpace.h"
#include "objectmanager/endpoint/Parameters.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace endpoint {

class Contexts;

/// One operation under way: what was asked, by whom, in which namespace. Elements of an answer may be written when the
/// call has ended: of all this, only namespace, schema and host are there then.
struct Call {
    const cimxml::Request& request;
    const Parameters& parameters;
    const NameSpace& space;
    const Caller& caller;
    const std::string& host; ///< of paths in answers
    Contexts& contexts;      ///< of enumerations that are pulled

    const om::Schema& schema() const { return *space.schema; }
    cimxml::Reading reading() const { return {*space.schema, space.name, cimxml::Trust::Schema}; }
};

[[noreturn]] inline void fail(int code, const std::string& description) {
    throw cimxml::CimError(code, description);
}

/// The class of that name; throws CimError with that code where there is none.
const om::ResolvedClass& knownClass(const Call& call, const std::string& name, int code = CMPI_RC_ERR_INVALID_CLASS);

/// A path whose class is known, with keys of the class only and with their types. Throws CimError: INVALID_CLASS, and
/// INVALID_PARAMETER for keys that cannot be.
om::ObjectPath typedPath(const Call& call, const cimxml::PathElement& element,
                         int unknownClass = CMPI_RC_ERR_INVALID_CLASS);
/// Throws INVALID_PARAMETER where a key of the class is missing.
void expectAllKeys(const Call& call, const om::ObjectPath& path);

bool isServed(const Call& call, std::string_view className);

/// Asks the namespace's provider; a status other than OK is thrown as CimError.
om::Answer ask(const Call& call, const om::Request& request);
/// Asks for each of these requests and hands over its answer, with its place among them. One that answers NOT_SUPPORTED
/// is passed over where another one answers.
void askEach(const Call& call, const std::vector<om::Request>& requests,
             const std::function<void(std::size_t, om::Answer)>& take);

om::Request requestFor(const Call& call, om::Operation operation, om::ObjectPath path);
om::Request requestFor(const Call& call, om::Operation operation, const std::string& className);

/// IRETURNVALUE around elements.
cimxml::Pieces returned(cimxml::Pieces elements);

} // namespace endpoint
