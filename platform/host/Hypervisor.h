#pragma once

namespace VK::Host {

/// Whether the processor says that it runs under KVM; false on processors that cannot say it.
bool processorSaysKvm();

} // namespace VK::Host
