#pragma once

#include <cstddef>
#include <string>

/// The ways to load the provider. Each prints one line of figures, and throws std::runtime_error with what went wrong.
namespace load {

/// Mixed requests from many threads at once; every answer must be that of a single thread.
void runThreads(const std::string& library, unsigned threads, unsigned seconds);

/// Mixed requests one after the other; memory and descriptors must stay flat once a tenth of them is done.
void runSoak(const std::string& library, std::size_t requests);

/// Loads the provider, asks it from this thread and from others that outlive it, and unloads it, so many times; every
/// library of the product must be gone after each time, and memory and descriptors must stay flat.
void runUnload(const std::string& library, unsigned times);

} // namespace load
