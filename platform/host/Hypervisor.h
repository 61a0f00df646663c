#pragma once

#include "host/HardwareFacts.h"

namespace VK::Host {

/// Whether the processor says that it runs under KVM; false on processors that cannot say it.
bool processorSaysKvm();

/// Whether the host below the root, which has these facts, is a KVM guest: by its firmware's names, and where it is the
/// running one by the processor.
bool isKvmGuest(const Root& root, const HardwareFacts& facts);

} // namespace VK::Host
