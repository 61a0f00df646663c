#pragma once

#include "objectmanager/broker/Object.h"

#include <string>

namespace om {

class DateTimeObject final : public Object<DateTimeObject, CMPIDateTime> {
public:
    static const CMPIDateTimeFT table;

    /// `text` is a valid date-time.
    DateTimeObject(Broker& broker, std::string text) : Object(broker), text_(std::move(text)) {}

    const std::string& text() const { return text_; }

private:
    void clear() noexcept override;

    std::string text_;
};

} // namespace om
