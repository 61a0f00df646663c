#pragma once

#include <cmpidt.h>
#include <cmpift.h>

#pragma GCC visibility push(hidden)

/// Whether an object manager offers an operation. Function tables may lack slots, and their version numbers are not to
/// be trusted.
namespace VK::Cmpi {

/// Whether an object is there and its slot is filled: hasSlot(path, &CMPIObjectPathFT::getKey).
template <typename Object, typename Slot, typename Table>
bool hasSlot(const Object* object, Slot Table::*slot) {
    return object != nullptr && object->ft != nullptr && object->ft->*slot != nullptr;
}

/// The same for the broker's own factories and services.
template <typename Slot>
bool hasService(const CMPIBroker* broker, Slot CMPIBrokerEncFT::*slot) {
    return broker != nullptr && broker->eft != nullptr && broker->eft->*slot != nullptr;
}

} // namespace VK::Cmpi

#pragma GCC visibility pop
