#pragma once

#include "vk/ProviderUtilities.h"

#include <string>
#include <type_traits>
#include <variant>
#include <vector>

namespace VK::BaseServerProvider {

namespace detail {
template <class Data, class Value>
using Getter = bool (Data::*)(Value&) const;

template <class Function>
struct GetterValue;
template <class Data, class Value>
struct GetterValue<bool (Data::*)(Value&) const> {
    using type = Value;
};
} // namespace detail

/// One property of a CIM class: its name, the data class's getter, and for a text whether it is a date-time. The CIM
/// type follows from the getter's.
template <class Data>
struct Property {
    const char* name;
    std::variant<detail::Getter<Data, std::string>, detail::Getter<Data, bool>, detail::Getter<Data, float>,
                 detail::Getter<Data, unsigned int>, detail::Getter<Data, unsigned short>,
                 detail::Getter<Data, std::vector<std::string>>, detail::Getter<Data, std::vector<unsigned short>>>
        getter;
    bool dateTime = false;
};

/// The mark of a date-time in a property table.
inline constexpr bool dateTime = true;

/// Sets the property if its getter supplies a value. Every getter gets a variable of its own, so that nothing of
/// another property can shine through.
template <class Data>
void publish(const CMPIBroker* broker, CMPIInstance* instance, const Data& data, const Property<Data>& property) {
    std::visit(
        [&](auto getter) {
            using Value = typename detail::GetterValue<decltype(getter)>::type;
            Value value{};
            if (!(data.*getter)(value)) return; // GCOVR_EXCL_BR_LINE: counted for each type of getter
            if constexpr (std::is_same_v<Value, std::string>) {
                if (property.dateTime) // GCOVR_EXCL_BR_LINE: counted for each type of getter
                    ProviderUtilities::setProperty(broker, instance, property.name, value, true);
                else
                    ProviderUtilities::setProperty(instance, property.name, value);
            } else if constexpr (std::is_same_v<Value, std::vector<std::string>> ||
                                 std::is_same_v<Value, std::vector<unsigned short>>) {
                ProviderUtilities::setProperty(broker, instance, property.name, value);
            } else {
                ProviderUtilities::setProperty(instance, property.name, value);
            }
        },
        property.getter);
}

} // namespace VK::BaseServerProvider
