#pragma once

#include "objectmanager/broker/Object.h"
#include "objectmanager/broker/ObjectManager.h"

#include <optional>
#include <string>

namespace om {

/// Where a provider's function puts its answer. What is returned is copied at once.
class ResultObject final : public Object<ResultObject, CMPIResult> {
public:
    static const CMPIResultFT table;

    ResultObject(Broker& broker, Operation request, Answer& target)
        : Object(broker), operation(request), answer(&target) {}

    Operation operation;
    Answer* answer;
    std::optional<std::string> errorMessage; ///< of the first error returned

private:
    void clear() noexcept override { invalidate(); }
};

} // namespace om
