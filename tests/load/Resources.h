#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace load {

/// What this process holds now.
struct Resources {
    std::size_t heap = 0;     ///< bytes handed out by malloc; 0 where heapTells() is false
    std::size_t resident = 0; ///< bytes; 0 where memoryTells() is false
    std::size_t descriptors = 0;

    static Resources now();
};

/// Whether memory can be judged: a sanitizer's allocator keeps what is freed.
bool memoryTells();

/// Whether it is known exactly what malloc handed out: not while each thread caches some of what it freed.
bool heapTells();

/// The product's libraries that are mapped into this process, by file name.
std::vector<std::string> mappedLibraries();

} // namespace load
