#pragma once

#include <cstddef>
#include <mutex>

namespace om {

/// Plain memory that a provider asks for. What it forgets to give back is freed when the broker goes.
class MemoryBlocks {
public:
    MemoryBlocks() = default;
    ~MemoryBlocks();
    MemoryBlocks(const MemoryBlocks&) = delete;
    MemoryBlocks& operator=(const MemoryBlocks&) = delete;

    /// As malloc, calloc, realloc and free. Null when there is no memory; `resize` then leaves the old block.
    void* allocate(std::size_t size);
    void* allocateZeroed(std::size_t count, std::size_t size);
    void* resize(void* pointer, std::size_t size);
    void free(void* pointer);

private:
    struct Block;
    void link(Block* block);
    void unlink(Block* block);

    std::mutex mutex;
    Block* first = nullptr;
};

} // namespace om
