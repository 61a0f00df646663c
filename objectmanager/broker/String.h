#pragma once

#include "objectmanager/broker/Object.h"

#include <string>

namespace om {

class StringObject final : public Object<StringObject, CMPIString> {
public:
    static const CMPIStringFT table;

    StringObject(Broker& broker, std::string text);
    StringObject(const StringObject& other);

    const std::string& text() const { return text_; }

private:
    void clear() noexcept override;

    std::string text_;
};

/// A string of the present call.
CMPIString* newString(Broker& broker, std::string text);
/// A string that is part of `parent`.
CMPIString* partString(const Managed& parent, std::string text);

} // namespace om
