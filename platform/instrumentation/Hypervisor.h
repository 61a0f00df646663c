#pragma once

namespace VK {
namespace Inside __attribute__((visibility("hidden"))) {

    /// Whether the processor says that it runs under KVM; false on processors that cannot say it.
    bool processorSaysKvm();

} // namespace )
} // namespace VK
