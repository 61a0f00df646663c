#pragma once

namespace VK {
#pragma GCC visibility push(hidden)
namespace Inside {

/// Whether the processor says that it runs under KVM; false on processors that cannot say it.
bool processorSaysKvm();

} // namespace Inside
#pragma GCC visibility pop
} // namespace VK
