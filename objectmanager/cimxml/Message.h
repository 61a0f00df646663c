#pragma once

#include "objectmanager/cimxml/Request.h"

#include <string>
#include <string_view>

namespace cimxml {

/// A whole answer around what IMETHODRESPONSE or METHODRESPONSE holds. The request's identifier and spelling of the
/// operation come back.
std::string response(const Request& request, std::string content);
/// An answer that is an error. The description goes onto one line of valid text, and is cut where it is very long.
std::string errorResponse(const Request& request, int code, std::string_view description);

/// The content with something before and behind it. Answers may be large: the content is moved where it lies, and never
/// there twice.
std::string enclosed(std::string_view before, std::string content, std::string_view behind);

/// The standard's name of a status: `CIM_ERR_FAILED`.
std::string errorName(int code);

} // namespace cimxml
