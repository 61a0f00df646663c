#pragma once

#include "objectmanager/broker/Object.h"

#include <optional>
#include <string>

namespace om {

/// What an extended error holds. Texts and arrays that were not set are null.
struct ErrorAttributes {
    using Text = std::optional<std::string>;

    CMPIErrorType type = UnknownErrorType;
    Text otherType;
    Text owner;
    Text messageId;
    Text message;
    CMPIErrorSeverity severity = ErrorSevUnknown;
    CMPIErrorProbableCause cause = ErrorProbCauseUnknown;
    Text causeDescription;
    Value recommendedActions{CMPI_stringA, {}};
    Text source;
    CMPIErrorSrcFormat sourceFormat = CMPIErrSrcUnknown;
    Text otherSourceFormat;
    CMPIrc code = CMPI_RC_OK;
    Text codeDescription;
    Value messageArguments{CMPI_stringA, {}};
};

class ErrorObject final : public Object<ErrorObject, CMPIError> {
public:
    static const CMPIErrorFT table;

    ErrorObject(Broker& broker, ErrorAttributes list) : Object(broker), attributes(std::move(list)) {}

    ErrorAttributes attributes;

private:
    void clear() noexcept override;
};

} // namespace om
