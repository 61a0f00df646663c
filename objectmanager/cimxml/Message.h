#pragma once

#include "objectmanager/cimxml/Pieces.h"
#include "objectmanager/cimxml/Request.h"

#include <string>
#include <string_view>

namespace cimxml {

/// A whole answer around what IMETHODRESPONSE or METHODRESPONSE holds. The request's identifier and spelling of the
/// operation come back.
Pieces response(const Request& request, Pieces content);
/// An answer that is an error. The description goes onto one line of valid text, and is cut where it is very long.
Pieces errorResponse(const Request& request, int code, std::string_view description);

/// The standard's name of a status: `CIM_ERR_FAILED`.
std::string errorName(int code);

} // namespace cimxml
